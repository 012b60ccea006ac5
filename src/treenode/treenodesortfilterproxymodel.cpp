// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "treenodesortfilterproxymodel.h"

#include "treenode.h"
#include "treenodeproxyhelper_p.h"

namespace {

// Bits of the special-flags filter and of a node's special flags.
const int hiddenFlag = 1;
const int markedFlag = 2;

} // namespace

TreeNodeSortFilterProxyModel::TreeNodeSortFilterProxyModel(int specialFlagsFilter, QObject *parent)
    : TreeNodeSortFilterProxyModel(QSet<int>(), specialFlagsFilter, parent)
{
}

TreeNodeSortFilterProxyModel::TreeNodeSortFilterProxyModel(QSet<int> acceptColumns,
                                                           int specialFlagsFilter, QObject *parent)
    : QSortFilterProxyModel(parent)
    , _specialFlagsFilter(specialFlagsFilter)
    , _acceptColumns(std::move(acceptColumns))
{
}

TreeNodeSortFilterProxyModel::~TreeNodeSortFilterProxyModel() = default;

QSet<int> TreeNodeSortFilterProxyModel::acceptColumns() const
{
    return _acceptColumns;
}

void TreeNodeSortFilterProxyModel::setAcceptColumns(const QSet<int> &acceptColumns)
{
    // The same set again would only make every view forget its state.
    if (acceptColumns == _acceptColumns)
        return;
    // The reset also drops the proxy's row and column mapping, which is built
    // with the old set of columns.
    beginResetModel();
    _acceptColumns = acceptColumns;
    endResetModel();
}

TreeNode *TreeNodeSortFilterProxyModel::rootNode() const
{
    return TreeNodeProxyHelper::rootNode(this);
}

TreeNode *TreeNodeSortFilterProxyModel::toTreeNode(const QModelIndex &index) const
{
    return TreeNodeProxyHelper::toTreeNode(this, index);
}

TreeNode *TreeNodeSortFilterProxyModel::toTreeNode(const QItemSelectionRange &range) const
{
    return TreeNodeProxyHelper::toTreeNode(this, range);
}

TreeNode *TreeNodeSortFilterProxyModel::toTreeNode(const QItemSelection &selection) const
{
    return TreeNodeProxyHelper::toTreeNode(this, selection);
}

QModelIndex TreeNodeSortFilterProxyModel::treeNodeToIndex(TreeNode *node) const
{
    return TreeNodeProxyHelper::treeNodeToIndex(this, node);
}

bool TreeNodeSortFilterProxyModel::filterAcceptsColumn(int sourceColumn, const QModelIndex &) const
{
    return _acceptColumns.isEmpty() || _acceptColumns.contains(sourceColumn);
}

bool TreeNodeSortFilterProxyModel::filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const
{
    const TreeNodeModelExtension *source = TreeNodeProxyHelper::extension(sourceModel());
    if (!source)
        return true;
    const QModelIndex sourceIndex = sourceModel()->index(sourceRow, 0, sourceParent);
    // An invalid index would stand for the root, which is no row.
    if (!sourceIndex.isValid())
        return true;
    const TreeNode *node = source->toTreeNode(sourceIndex);
    if (!node)
        return true;

    const int flags = node->treeNodeSpecialFlags();
    if ((_specialFlagsFilter & hiddenFlag) && (flags & hiddenFlag))
        return false;
    if (_specialFlagsFilter & markedFlag)
        return flags & markedFlag;
    return true;
}
