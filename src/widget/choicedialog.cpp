// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "choicedialog.h"
#include "ui_abstractchoicedialog.h"

#include "choicefiltertreenodesortfilterproxymodel.h"
#include "choicetreenodeproxymodel.h"

ChoiceDialog::ChoiceDialog(QWidget *parent)
    : AbstractChoiceDialog(parent)
{
    _model = new ChoiceFilterTreeNodeSortFilterProxyModel(false, this);
    afterConstructor();
}

ChoiceDialog::~ChoiceDialog() = default;

void ChoiceDialog::setChoiceModel(ChoiceTreeNodeProxyModel *model)
{
    QAbstractItemModel *current = _model->sourceModel();
    if (current == model)
        return;
    // A name ticked elsewhere leaves the list, and may take the selection
    // with it: OK follows.
    if (current)
        disconnect(current, SIGNAL(dataChanged( QModelIndex, QModelIndex )), this, SLOT(selectionChanged()));
    _model->setSourceModel(model);
    if (model)
        connect(model, SIGNAL(dataChanged( QModelIndex, QModelIndex )), this, SLOT(selectionChanged()));
    selectionChanged();
}

void ChoiceDialog::makeChoice()
{
    auto *choiceModel = qobject_cast<ChoiceTreeNodeProxyModel *>(_model->sourceModel());
    if (!choiceModel)
        return;
    QItemSelectionModel *selection = _ui->_nodeTreeView->selectionModel();
    // Each ticked row leaves this not-ticked list and so the selection.
    while (selection->hasSelection()) {
        const QPersistentModelIndex index = selection->selectedIndexes().constFirst();
        const QModelIndex source = _model->mapToSource(index);
        choiceModel->setData(source.sibling(source.row(), choiceModel->nameColumn()), true,
                             choiceModel->choiceRole());
        // A row that could not be ticked, or that stays in the list, is
        // dropped from the selection so that the loop ends.
        if (index.isValid() && selection->isSelected(index))
            selection->select(index, QItemSelectionModel::Deselect | QItemSelectionModel::Rows);
    }
}
