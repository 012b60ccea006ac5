// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_MODULEROOTTREENODE_H
#define KVT_MODULEROOTTREENODE_H

#include "treenode.h"

/*!
 * The invisible root of the module tree, with the columns "Name", "Reread"
 * and "Description". Its expected depth is 0 and its id empty, so modules of
 * expected depth 1 without an expected parent hang directly below it.
 */
class KVTCOMMON_EXPORT ModuleRootTreeNode : public TreeNode
{
    Q_OBJECT

public:
    //! Creates the empty root (depth 0, empty id).
    explicit ModuleRootTreeNode(QObject *parent = nullptr);
    //! Destroys the root; the modules are detached, not deleted.
    ~ModuleRootTreeNode() override;

    //! Three columns: "Name", "Reread" and "Description".
    int columnCount() const override;
    //! The translated column names for the horizontal header.
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
};

#endif // KVT_MODULEROOTTREENODE_H
