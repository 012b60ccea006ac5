// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "nodeselementwidget.h"

#include "element.h"
#include "elementmodel.h"
#include "listelementwidgetform_p.h"
#include "nodeswidgetproxymodel.h"
#include "ui_nodeselementwidget.h"

NodesElementWidget::NodesElementWidget(const QString &type, Module &module, RightsPredicate check,
                                       QWidget *parent)
    : ListElementWidget(type, module, check, parent)
{
    auto *form = new ListElementWidgetFormOf<Ui::NodesElementWidget>;
    _ui = form;
    form->setupUi(this);
    _proxy = new NodesWidgetProxyModel(1, this);
    _proxy->setSourceModel(_model);
    form->_elementTreeView->setModel(_proxy);
    connectView();
}

NodesElementWidget::~NodesElementWidget() = default;

void NodesElementWidget::read()
{
    if (_role != EditElementRole || !_element)
        return;
    if (!_model->rootNode())
        _model->setRootNode(_element);
}

void NodesElementWidget::choiceElement(const QModelIndex &index)
{
    chooseElement(index);
}

void NodesElementWidget::customContextMenuRequest(const QPoint &pos)
{
    relayContextMenuRequest(pos);
}
