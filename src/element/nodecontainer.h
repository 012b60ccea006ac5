#ifndef KVT_NODECONTAINER_H
#define KVT_NODECONTAINER_H

#include "kvtcommon_export.h"

#include <QObject>

class TreeNode;
class TreeNodeModel;

/*!
 * Owner of the root of one tree and of the item model that shows it.
 *
 * A container announces when its tree is rebuilt as a whole
 * (nodeContainerAboutToBeReset() and nodeContainerReset()), and relays the
 * requests to make a node current or to expand it, so that views listen to
 * the container rather than to the nodes.
 *
 * The base holds neither a root nor a model; PluginContainer and
 * ElementContainer make their own.
 */
class KVTCOMMON_EXPORT NodeContainer : public QObject
{
    Q_OBJECT

public:
    explicit NodeContainer(QObject *parent = nullptr);
    ~NodeContainer() override;

    TreeNode *rootNode() const { return _rootNode; }
    TreeNodeModel *treeNodeModel() const { return _treeNodeModel; }

Q_SIGNALS:
    void nodeContainerAboutToBeReset();
    void nodeContainerReset(const TreeNode *root);
    void setCurrentNode(TreeNode *node);
    void expandCurrentNode(TreeNode *node);

protected:
    TreeNode *_rootNode;
    TreeNodeModel *_treeNodeModel;
};

#endif // KVT_NODECONTAINER_H
