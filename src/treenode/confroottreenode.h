// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    //! Creates an empty root of depth 0 with an empty id.
    explicit ConfRootTreeNode(QObject *parent = nullptr);
    //! Destroys the whole subtree (clearDeleteAll()).
    ~ConfRootTreeNode() override;

    //! Two columns, "Name" and "Value".
    int columnCount() const override;
    //! The translated "Name" and "Value" for the horizontal header.
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
};

#endif // KVT_CONFROOTTREENODE_H
