// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    //! The root of the tree shown, or null when there is none.
    virtual TreeNode *rootNode() const = 0;
    /*!
     * The node of \a index. An invalid index maps to the root; an index of another
     * model maps to null.
     */
    virtual TreeNode *toTreeNode(const QModelIndex &index) const = 0;
    /*!
     * The node of the first index of \a range that maps to a node; null for a
     * range of another model.
     */
    virtual TreeNode *toTreeNode(const QItemSelectionRange &range) const = 0;
    //! The first node that toTreeNode() finds over the ranges of \a selection, or null.
    virtual TreeNode *toTreeNode(const QItemSelection &selection) const = 0;
    /*!
     * The index of \a node in column 0; invalid for null, for the root and for a
     * node that is not under the root (or hidden by a proxy).
     */
    virtual QModelIndex treeNodeToIndex(TreeNode *node) const = 0;

protected:
    // Not virtual: the interface adds only the five mapping slots above to a
    // model's virtual table. Objects are destroyed through their model type.
    //! Objects are destroyed through their model type, never through this interface.
    ~TreeNodeModelExtension() = default;
};

#endif // KVT_TREENODEMODELEXTENSION_H
