// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "listelementwidget.h"

#include "element.h"
#include "elementmodel.h"
#include "elementtreeview.h"
#include "listelementwidgetform_p.h"
#include "listwidgetproxymodel.h"

#include <QHeaderView>

ListElementWidget::ListElementWidget(const QString &type, Module &module, RightsPredicate check,
                                     QWidget *parent)
    : ElementWidget(module, check, parent)
    , _model(new ElementModel(this))
    , _proxy(nullptr)
    , _ui(nullptr)
{
    _elementType = type;
}

ListElementWidget::~ListElementWidget()
{
    // Only the form object: the widgets it points to are children of this one.
    delete _ui;
}

QString ListElementWidget::toolTipText() const
{
    return _element ? _element->toolTipText() : windowTitle();
}

ElementTreeView *ListElementWidget::elementTreeView() const
{
    return _ui ? _ui->view() : nullptr;
}

void ListElementWidget::connectView()
{
    ElementTreeView *view = elementTreeView();
    if (!view)
        return;
    connect(view, SIGNAL(doubleClicked( QModelIndex )), this, SLOT(choiceElement( QModelIndex )));
    connect(view, SIGNAL(elementContextOperationChangedFocused( Element * )), this,
            SIGNAL(elementContextOperationChanged( Element * )));
    connect(view, SIGNAL(elementContextOperationChangedSelected( Element * )), this,
            SIGNAL(elementContextOperationChanged( Element * )));
    connect(view, SIGNAL(customContextMenuRequested( QPoint )), this,
            SLOT(customContextMenuRequest( QPoint )));
    // A sortable list opens sorted ascending on its first column (the header
    // alone would start descending); a stored header state restored later
    // takes precedence.
    if (view->isSortingEnabled())
        view->header()->setSortIndicator(0, Qt::AscendingOrder);
}

void ListElementWidget::chooseElement(const QModelIndex &index)
{
    Element *element = _proxy ? _proxy->toElement(index) : nullptr;
    if (!element)
        return;
    if (ElementTreeView *view = elementTreeView())
        view->clearSelection();
    element->emitSetCurrentNode();
}

void ListElementWidget::relayContextMenuRequest(const QPoint &pos)
{
    ElementTreeView *view = elementTreeView();
    if (!view)
        return;
    // The view reports a point of its viewport, which starts below the
    // header. A hidden header takes no room, whatever geometry it was last
    // given.
    const QHeaderView *header = view->header();
    const QRect geometry = header->geometry();
    const int headerHeight = header->isHidden() ? 0 : geometry.bottom() - geometry.top() + 1;
    Q_EMIT customContextMenuRequested(view->mapToGlobal(pos + QPoint(0, headerHeight)));
}
