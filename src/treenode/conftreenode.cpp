// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "conftreenode.h"

ConfTreeNode::ConfTreeNode(const QString &name, const QString &value, QObject *parent)
    : TreeNode(parent)
    , _name(name)
    , _value(value)
{
    _id = QStringLiteral("Conf_%1_%2").arg(name, value);
    _expectedDepth = 1;
}

QVariant ConfTreeNode::data(int column, int role) const
{
    // Only text roles: a configuration line has no id roles of its own to show.
    if (role != Qt::DisplayRole && role != Qt::ToolTipRole)
        return QVariant();
    switch (column) {
    case 0:
        return _name;
    case 1:
        return _value;
    default:
        return QVariant();
    }
}
