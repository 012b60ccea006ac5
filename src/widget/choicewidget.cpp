// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "choicewidget.h"
#include "ui_choicewidget.h"

#include "choicedialog.h"
#include "choicetreenodeproxymodel.h"
#include "choicetreenodesortfilterproxymodel.h"

#include <QHeaderView>

ChoiceWidget::ChoiceWidget(QWidget *parent)
    : QGroupBox(parent)
    , _ui(new Ui::ChoiceWidget)
    , _choiceDialog(nullptr)
    , _model(nullptr)
    , _choiceModel(nullptr)
    , _choiceEnabled(true)
{
    _ui->setupUi(this);
    _choiceDialog = new ChoiceDialog(this);
    _model = new ChoiceTreeNodeSortFilterProxyModel(true, this);
    _model->setDynamicSortFilter(true);
    _ui->_nodeTreeView->setModel(_model);
    _ui->_nodeTreeView->header()->setSectionResizeMode(QHeaderView::ResizeToContents);

    connect(_ui->_addPushButton, SIGNAL(clicked()), _choiceDialog, SLOT(show()));
    connect(_ui->_removePushButton, SIGNAL(clicked()), this, SLOT(unchoice()));
    connect(_ui->_nodeTreeView, SIGNAL(doubleClicked(QModelIndex)), this, SLOT(doubleClicked(QModelIndex)));
    connect(_ui->_nodeTreeView->selectionModel(), SIGNAL(selectionChanged(QItemSelection, QItemSelection )),
            this, SLOT(selectionChanged(QItemSelection)));
    // A reset of the list drops the selection without a selection signal.
    connect(_model, SIGNAL(modelReset()), this, SLOT(selectionChanged()));
}

ChoiceWidget::~ChoiceWidget()
{
    delete _ui;
}

void ChoiceWidget::setChoiceModel(ChoiceTreeNodeProxyModel *model)
{
    _choiceModel = model;
    _choiceDialog->setChoiceModel(model);
    if (_model->sourceModel() != model)
        _model->setSourceModel(model);
}

QSet<int> ChoiceWidget::acceptColumns() const
{
    return _model->acceptColumns();
}

void ChoiceWidget::setAcceptColumns(const QSet<int> &columns)
{
    _model->setAcceptColumns(columns);
}

void ChoiceWidget::setChoiceEnabled(bool enabled)
{
    if (_choiceEnabled == enabled)
        return;
    _choiceEnabled = enabled;
    if (enabled) {
        _ui->_nodeTreeView->setSelectionMode(QAbstractItemView::ExtendedSelection);
        _ui->_addPushButton->setEnabled(true);
    } else {
        _ui->_nodeTreeView->setSelectionMode(QAbstractItemView::NoSelection);
        _ui->_addPushButton->setEnabled(false);
        _ui->_nodeTreeView->clearSelection();
    }
}

void ChoiceWidget::selectionChanged(const QItemSelection &)
{
    // The whole selection decides, not the part that has just changed: a
    // row deselected with others still selected leaves Remove enabled.
    const QItemSelectionModel *selection = _ui->_nodeTreeView->selectionModel();
    _ui->_removePushButton->setEnabled(selection && selection->hasSelection());
}

void ChoiceWidget::doubleClicked(const QModelIndex &index)
{
    if (TreeNode *node = _model->toTreeNode(index))
        emit treeNodeDoubleClicked(node);
}

void ChoiceWidget::unchoice()
{
    if (!_choiceModel || _model->sourceModel() != _choiceModel)
        return;
    QItemSelectionModel *selection = _ui->_nodeTreeView->selectionModel();
    // Each unticked row leaves this ticked list and so the selection.
    while (selection->hasSelection()) {
        const QPersistentModelIndex index = selection->selectedIndexes().constFirst();
        const QModelIndex source = _model->mapToSource(index);
        _choiceModel->setData(source.sibling(source.row(), _choiceModel->nameColumn()), false,
                              _choiceModel->choiceRole());
        // A row that could not be unticked, or that stays in the list, is
        // dropped from the selection so that the loop ends.
        if (index.isValid() && selection->isSelected(index))
            selection->select(index, QItemSelectionModel::Deselect | QItemSelectionModel::Rows);
    }
}
