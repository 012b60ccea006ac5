#ifndef KVT_TREENODEPROXYHELPER_P_H
#define KVT_TREENODEPROXYHELPER_P_H

#include <QItemSelection>
#include <QModelIndex>

class QAbstractItemModel;
class QAbstractProxyModel;
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

} // namespace TreeNodeProxyHelper

#endif // KVT_TREENODEPROXYHELPER_P_H
