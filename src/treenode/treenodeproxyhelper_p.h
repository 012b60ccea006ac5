// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TREENODEPROXYHELPER_P_H
#define KVT_TREENODEPROXYHELPER_P_H

#include <QItemSelection>
#include <QModelIndex>
#include <QSet>

class QAbstractItemModel;
class QAbstractProxyModel;
class QSortFilterProxyModel;
class TreeNode;
class TreeNodeModelExtension;

/*
 * The node mapping shared by every proxy over a tree-node model. A proxy
 * answers by asking its source, which may itself be a proxy: the chain ends at
 * the TreeNodeModel.
 */
namespace TreeNodeProxyHelper {

// The source as a tree-node model, or null when there is none or it is some
// other kind of model.
TreeNodeModelExtension *extension(const QAbstractItemModel *model);

TreeNode *rootNode(const QAbstractProxyModel *proxy);
TreeNode *toTreeNode(const QAbstractProxyModel *proxy, const QModelIndex &index);
TreeNode *toTreeNode(const QAbstractProxyModel *proxy, const QItemSelectionRange &range);
TreeNode *toTreeNode(const QAbstractProxyModel *proxy, const QItemSelection &selection);
QModelIndex treeNodeToIndex(const QAbstractProxyModel *proxy, TreeNode *node);

// The text filter of the filtering proxies: whether the display text of one
// of \a columns of the source row matches the proxy's expression (every
// column from \a firstColumn on when \a columns is empty). An empty or
// invalid expression, or no source, accepts the row.
bool textFilterAccepts(const QSortFilterProxyModel *proxy, int sourceRow, const QModelIndex &sourceParent,
                       const QSet<int> &columns, int firstColumn = 0);

} // namespace TreeNodeProxyHelper

#endif // KVT_TREENODEPROXYHELPER_P_H
