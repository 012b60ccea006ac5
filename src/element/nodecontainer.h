// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    //! Creates a container without root or model.
    explicit NodeContainer(QObject *parent = nullptr);
    //! Destroys the container.
    ~NodeContainer() override;

    //! The root of the container's tree.
    TreeNode *rootNode() const { return _rootNode; }
    //! The model that shows the tree; give it to views.
    TreeNodeModel *treeNodeModel() const { return _treeNodeModel; }

Q_SIGNALS:
    //! The tree is about to be rebuilt as a whole.
    void nodeContainerAboutToBeReset();
    //! The tree has been rebuilt under \a root.
    void nodeContainerReset(const TreeNode *root);
    //! Views are asked to make \a node current.
    void setCurrentNode(TreeNode *node);
    //! Views are asked to expand \a node.
    void expandCurrentNode(TreeNode *node);

protected:
    //! See rootNode(); set by the derived container.
    TreeNode *_rootNode;
    //! See treeNodeModel(); set by the derived container.
    TreeNodeModel *_treeNodeModel;
};

#endif // KVT_NODECONTAINER_H
