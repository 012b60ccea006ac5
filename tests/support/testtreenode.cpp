// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "testtreenode.h"

TestTreeNode::TestTreeNode(const QString &id, QObject *parent, int expectedDepth,
                           const QString &expectedParentId)
    : TreeNode(expectedDepth, expectedParentId, parent)
{
    setId(id);
}

QVariant TestTreeNode::data(int column, int role) const
{
    if (role != Qt::DisplayRole && role != Qt::EditRole)
        return TreeNode::data(column, role);
    const QString shown = text.isEmpty() ? id() : text;
    return column == 0 ? shown : QStringLiteral("%1:%2").arg(shown).arg(column);
}

bool TestTreeNode::setData(int column, const QVariant &value, int role)
{
    if (column != 0 || role != Qt::EditRole)
        return false;
    text = value.toString();
    return true;
}
