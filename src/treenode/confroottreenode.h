#ifndef KVT_CONFROOTTREENODE_H
#define KVT_CONFROOTTREENODE_H

#include "treenode.h"

/*!
 * The invisible root of a configuration listing with the columns "Name" and
 * "Value". Unlike a plain TreeNode it owns its subtree and destroys it.
 */
class KVTCOMMON_EXPORT ConfRootTreeNode : public TreeNode
{
    Q_OBJECT

public:
    explicit ConfRootTreeNode(QObject *parent = nullptr);
    ~ConfRootTreeNode() override;

    int columnCount() const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
};

#endif // KVT_CONFROOTTREENODE_H
