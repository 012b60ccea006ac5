// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementroottreenode.h"

#include "elementtreeops_p.h"

ElementRootTreeNode::ElementRootTreeNode(QObject *parent)
    : TreeNode(0, QString(), parent)
{
}

ElementRootTreeNode::~ElementRootTreeNode() = default;

void ElementRootTreeNode::insert(int position, const QList<TreeNode *> &nodes)
{
    ElementTreeOps::insert(this, position, nodes);
}

void ElementRootTreeNode::removeAt(int position, int count)
{
    ElementTreeOps::removeAt(this, position, count);
}

int ElementRootTreeNode::columnCount() const
{
    return 1;
}

QVariant ElementRootTreeNode::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (section == 0 && orientation == Qt::Horizontal && role == Qt::DisplayRole)
        return tr("Name");
    return QVariant();
}
