// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTTREEOPS_P_H
#define KVT_ELEMENTTREEOPS_P_H

#include <QList>

class TreeNode;

// Insertion and removal shared by Element and ElementRootTreeNode: the
// TreeNode behaviour followed by InsertedOperation or RemovedOperation on
// every element that came or went.
namespace ElementTreeOps {
void insert(TreeNode *self, int position, const QList<TreeNode *> &nodes);
void removeAt(TreeNode *self, int position, int count);
}

#endif
