#ifndef KVT_ELEMENTROOTTREENODE_H
#define KVT_ELEMENTROOTTREENODE_H

#include "treenode.h"

/*!
 * The invisible root of an element tree, with the one column "Name".
 * Inserting and removing elements directly below it notifies their modules
 * exactly as an Element does for its children.
 */
class KVTCOMMON_EXPORT ElementRootTreeNode : public TreeNode
{
    Q_OBJECT

public:
    explicit ElementRootTreeNode(QObject *parent = nullptr);
    ~ElementRootTreeNode() override;

    void insert(int position, const QList<TreeNode *> &nodes) override;
    void removeAt(int position, int count) override;
    int columnCount() const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

    using TreeNode::insert;
};

#endif // KVT_ELEMENTROOTTREENODE_H
