// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "treestring.h"

#include "testtreenode.h"

#include <QAbstractItemModel>
#include <QRegularExpression>
#include <QVector>

#include <algorithm>

namespace TreeString {

void build(TreeNode *root, const QString &description)
{
    static const QRegularExpression token(QStringLiteral("[^\\s\\[\\]]+|\\[|\\]"));
    QVector<TreeNode *> parents{root};
    TreeNode *last = nullptr;
    for (auto it = token.globalMatch(description); it.hasNext();) {
        const QString t = it.next().captured();
        if (t == QLatin1String("["))
            parents.append(last);
        else if (t == QLatin1String("]"))
            last = parents.takeLast();
        else
            parents.last()->append(last = new TestTreeNode(t, root));
    }
}

TestTreeNode *makeTree(const QString &description, QObject *owner)
{
    auto *root = new TestTreeNode(QStringLiteral("root"), owner);
    build(root, description);
    return root;
}

QString fromTree(const TreeNode *node)
{
    QStringList parts;
    for (const TreeNode *child : node->childNodes())
        parts << child->id() + (child->childNodesCount() ? '[' + fromTree(child) + ']' : QString());
    return parts.join(QLatin1Char(' '));
}

QString fromModel(const QAbstractItemModel *model, const QModelIndex &parent, int role)
{
    QStringList parts;
    for (int row = 0; row < model->rowCount(parent); ++row) {
        const QModelIndex index = model->index(row, 0, parent);
        const bool children = model->rowCount(index) > 0;
        parts << index.data(role).toString() + (children ? '[' + fromModel(model, index, role) + ']' : QString());
    }
    return parts.join(QLatin1Char(' '));
}

TreeNode *find(const TreeNode *root, const QString &path)
{
    TreeNode *node = const_cast<TreeNode *>(root);
    for (const QString &id : path.split(QLatin1Char('/'))) {
        const QList<TreeNode *> children = node->childNodes();
        auto it = std::find_if(children.begin(), children.end(), [&id](TreeNode *c) { return c->id() == id; });
        if (it == children.end())
            return nullptr;
        node = *it;
    }
    return node;
}

} // namespace TreeString
