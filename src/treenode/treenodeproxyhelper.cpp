// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "treenodeproxyhelper_p.h"

#include <QRegExp>
#include <QSortFilterProxyModel>

#include <algorithm>

#include "treenodemodelextension.h"

#include <QAbstractProxyModel>

namespace TreeNodeProxyHelper {

TreeNodeModelExtension *extension(const QAbstractItemModel *model)
{
    return dynamic_cast<TreeNodeModelExtension *>(const_cast<QAbstractItemModel *>(model));
}

TreeNode *rootNode(const QAbstractProxyModel *proxy)
{
    const TreeNodeModelExtension *source = extension(proxy->sourceModel());
    return source ? source->rootNode() : nullptr;
}

TreeNode *toTreeNode(const QAbstractProxyModel *proxy, const QModelIndex &index)
{
    const TreeNodeModelExtension *source = extension(proxy->sourceModel());
    if (!source)
        return nullptr;
    // An index without a model stands for the root, as in the source.
    if (!index.model())
        return source->toTreeNode(QModelIndex());
    if (index.model() != proxy)
        return nullptr;
    // Nodes are found through column 0: that is where the source keeps the
    // children, and any column of a row names the same node.
    const QModelIndex first = index.sibling(index.row(), 0);
    const QModelIndex sourceIndex = proxy->mapToSource(first.isValid() ? first : index);
    // A row of ours always has a source row; an invalid answer here would
    // otherwise be taken for the root.
    if (!sourceIndex.isValid())
        return nullptr;
    return source->toTreeNode(sourceIndex);
}

TreeNode *toTreeNode(const QAbstractProxyModel *proxy, const QItemSelectionRange &range)
{
    if (!extension(proxy->sourceModel()) || range.model() != proxy)
        return nullptr;
    const QModelIndexList indexes = range.indexes();
    for (const QModelIndex &index : indexes) {
        if (TreeNode *node = toTreeNode(proxy, index))
            return node;
    }
    return nullptr;
}

TreeNode *toTreeNode(const QAbstractProxyModel *proxy, const QItemSelection &selection)
{
    for (const QItemSelectionRange &range : selection) {
        if (TreeNode *node = toTreeNode(proxy, range))
            return node;
    }
    return nullptr;
}

QModelIndex treeNodeToIndex(const QAbstractProxyModel *proxy, TreeNode *node)
{
    const TreeNodeModelExtension *source = extension(proxy->sourceModel());
    if (!source || !node)
        return QModelIndex();
    const QModelIndex sourceIndex = source->treeNodeToIndex(node);
    if (!sourceIndex.isValid())
        return QModelIndex();
    const QModelIndex index = proxy->mapFromSource(sourceIndex);
    if (index.isValid())
        return index;
    // Column 0 of the source may be hidden by the proxy; the row is then
    // reached through the first column that is shown.
    const int columns = proxy->sourceModel()->columnCount(sourceIndex.parent());
    for (int column = 1; column < columns; ++column) {
        const QModelIndex other = proxy->mapFromSource(sourceIndex.sibling(sourceIndex.row(), column));
        if (other.isValid())
            return other;
    }
    return QModelIndex();
}

bool textFilterAccepts(const QSortFilterProxyModel *proxy, int sourceRow, const QModelIndex &sourceParent,
                       const QSet<int> &columns, int firstColumn)
{
    const QRegExp regExp = proxy->filterRegExp();
    if (regExp.isEmpty() || !regExp.isValid())
        return true;
    const QAbstractItemModel *source = proxy->sourceModel();
    if (!source)
        return true;
    auto matches = [&](int column) {
        const QModelIndex index = source->index(sourceRow, column, sourceParent);
        return index.isValid() && index.data(Qt::DisplayRole).toString().indexOf(regExp) != -1;
    };
    if (!columns.isEmpty())
        return std::any_of(columns.begin(), columns.end(), matches);
    const int count = source->columnCount(sourceParent);
    for (int column = firstColumn; column < count; ++column) {
        if (matches(column))
            return true;
    }
    return false;
}

} // namespace TreeNodeProxyHelper
