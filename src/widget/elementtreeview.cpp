#include "elementtreeview.h"

#include "element.h"
#include "elementmodelextension.h"
#include "elementviewhelper_p.h"

ElementTreeView::ElementTreeView(QWidget *parent)
    : QTreeView(parent)
{
    setContextMenuPolicy(Qt::CustomContextMenu);
}

ElementTreeView::~ElementTreeView() = default;

void ElementTreeView::setModel(QAbstractItemModel *model)
{
    // The old selection model outlives the switch (the base view does not
    // delete it), so its connection must be cut before it is replaced.
    disconnectModel();
    QTreeView::setModel(model);
    connectModel();
}

void ElementTreeView::setSelectionModel(QItemSelectionModel *selectionModel)
{
    ElementViewHelper::disconnectSelectionModel(this, this->selectionModel());
    QTreeView::setSelectionModel(selectionModel);
    ElementViewHelper::connectSelectionModel(this, this->selectionModel());
}

void ElementTreeView::connectModel()
{
    ElementViewHelper::connectModel(this, model());
    ElementViewHelper::connectSelectionModel(this, selectionModel());
}

void ElementTreeView::disconnectModel()
{
    ElementViewHelper::disconnectModel(this, model());
    ElementViewHelper::disconnectSelectionModel(this, selectionModel());
}

void ElementTreeView::emitCurrentElementChanged_Selection(const QItemSelection &selected)
{
    const QModelIndex index = ElementViewHelper::firstIndex(selected);
    Q_EMIT currentElementChangedStructure(index);
    // Without the focus the selection was made by the program (a search, a
    // restored state): the operations offered to the user stay those of the
    // widget that has the focus.
    if (!hasFocus())
        return;
    if (const ElementModelExtension *elements = ElementViewHelper::elements(this))
        Q_EMIT elementContextOperationChangedSelected(elements->toElement(index));
}

void ElementTreeView::emitCurrentElementChanged_InsertRemove(const QModelIndex &parent)
{
    if (ElementViewHelper::selectionContains(selectionModel(), parent))
        Q_EMIT currentElementChangedStructure(parent);
}

void ElementTreeView::emitCurrentElementChanged_Changed(const QModelIndex &topLeft,
                                                          const QModelIndex &bottomRight)
{
    const QModelIndex index = ElementViewHelper::firstChangedSelected(selectionModel(), topLeft,
                                                                      bottomRight);
    if (!index.isValid())
        return;
    if (const ElementModelExtension *elements = ElementViewHelper::elements(this))
        Q_EMIT elementContextOperationChangedChanged(elements->toElement(index));
}

void ElementTreeView::focusInEvent(QFocusEvent *event)
{
    if (const ElementModelExtension *elements = ElementViewHelper::elements(this)) {
        const QModelIndex index = selectionModel()
            ? ElementViewHelper::firstIndex(selectionModel()->selection())
            : QModelIndex();
        Q_EMIT elementContextOperationChangedFocused(elements->toElement(index));
    }
    QTreeView::focusInEvent(event);
}
