#ifndef KVT_TREENODEMODELEXTENSION_H
#define KVT_TREENODEMODELEXTENSION_H

#include "kvtcommon_export.h"

#include <QItemSelection>
#include <QModelIndex>

class TreeNode;

/*!
 * Maps between model indexes and tree nodes. Implemented by TreeNodeModel
 * and by every proxy stacked on it, so that views and widgets reach the nodes
 * without knowing which model they hold.
 */
class KVTCOMMON_EXPORT TreeNodeModelExtension
{
public:
    virtual TreeNode *rootNode() const = 0;
    virtual TreeNode *toTreeNode(const QModelIndex &index) const = 0;
    virtual TreeNode *toTreeNode(const QItemSelectionRange &range) const = 0;
    virtual TreeNode *toTreeNode(const QItemSelection &selection) const = 0;
    virtual QModelIndex treeNodeToIndex(TreeNode *node) const = 0;

protected:
    // Not virtual: the interface adds only the five mapping slots above to a
    // model's virtual table. Objects are destroyed through their model type.
    ~TreeNodeModelExtension() = default;
};

#endif // KVT_TREENODEMODELEXTENSION_H
