// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    //! Creates the empty root (depth 0, empty id).
    explicit ElementRootTreeNode(QObject *parent = nullptr);
    //! Destroys the root; the elements are detached, not deleted.
    ~ElementRootTreeNode() override;

    //! Inserts, then performs InsertedOperation on every inserted element through its module.
    void insert(int position, const QList<TreeNode *> &nodes) override;
    //! Removes, then performs RemovedOperation on every removed element through its module.
    void removeAt(int position, int count) override;
    //! One column.
    int columnCount() const override;
    //! The translated "Name".
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;

    using TreeNode::insert;
};

#endif // KVT_ELEMENTROOTTREENODE_H
