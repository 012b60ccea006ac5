#include "treestring.h"

#include "testtreenode.h"

#include <QAbstractItemModel>
#include <QStringList>

namespace TreeString {

namespace {

void buildLevel(TreeNode *parent, QObject *owner, const QString &text, int &pos)
{
    TreeNode *last = nullptr;
    while (pos < text.size()) {
        const QChar c = text.at(pos);
        if (c.isSpace()) {
            ++pos;
        } else if (c == QLatin1Char('[')) {
            ++pos;
            Q_ASSERT(last);
            buildLevel(last, owner, text, pos);
        } else if (c == QLatin1Char(']')) {
            ++pos;
            return;
        } else {
            const int start = pos;
            while (pos < text.size() && !text.at(pos).isSpace() && text.at(pos) != QLatin1Char('[')
                   && text.at(pos) != QLatin1Char(']'))
                ++pos;
            last = new TestTreeNode(text.mid(start, pos - start), owner);
            parent->append(last);
        }
    }
}

} // namespace

void build(TreeNode *root, const QString &description)
{
    int pos = 0;
    buildLevel(root, root, description, pos);
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
    for (const TreeNode *child : node->childNodes()) {
        QString part = child->id();
        if (child->childNodesCount() > 0)
            part += QLatin1Char('[') + fromTree(child) + QLatin1Char(']');
        parts.append(part);
    }
    return parts.join(QLatin1Char(' '));
}

QString fromModel(const QAbstractItemModel *model, const QModelIndex &parent, int role)
{
    QStringList parts;
    const int rows = model->rowCount(parent);
    for (int row = 0; row < rows; ++row) {
        const QModelIndex index = model->index(row, 0, parent);
        QString part = index.data(role).toString();
        if (model->rowCount(index) > 0)
            part += QLatin1Char('[') + fromModel(model, index, role) + QLatin1Char(']');
        parts.append(part);
    }
    return parts.join(QLatin1Char(' '));
}

TreeNode *find(const TreeNode *root, const QString &path)
{
    const TreeNode *node = root;
    const QStringList ids = path.split(QLatin1Char('/'));
    for (const QString &id : ids) {
        const TreeNode *next = nullptr;
        for (const TreeNode *child : node->childNodes()) {
            if (child->id() == id) {
                next = child;
                break;
            }
        }
        if (!next)
            return nullptr;
        node = next;
    }
    return const_cast<TreeNode *>(node);
}

} // namespace TreeString
