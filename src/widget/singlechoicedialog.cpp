// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "singlechoicedialog.h"
#include "ui_abstractchoicedialog.h"

#include "filtertreenodesortfilterproxymodel.h"
#include "treenodemodel.h"

SingleChoiceDialog::SingleChoiceDialog(TreeNode *rootNode, QWidget *parent)
    : AbstractChoiceDialog(parent)
    , _treeNodeModel(new TreeNodeModel(rootNode, this))
    , _choosenTreeNode(nullptr)
{
    _model = new FilterTreeNodeSortFilterProxyModel(1, this);
    _model->setSourceModel(_treeNodeModel);
    _ui->_nodeTreeView->setSelectionMode(QAbstractItemView::SingleSelection);
    afterConstructor();
}

SingleChoiceDialog::~SingleChoiceDialog() = default;

void SingleChoiceDialog::makeChoice()
{
    const QModelIndexList selected = _ui->_nodeTreeView->selectionModel()->selectedIndexes();
    if (!selected.isEmpty())
        _choosenTreeNode = _model->toTreeNode(selected.constFirst());
}

void SingleChoiceDialog::showEvent(QShowEvent *event)
{
    _ui->_nodeTreeView->clearSelection();
    AbstractChoiceDialog::showEvent(event);
}
