#include "signallog.h"

#include <kvt-common/treenode.h>

#include <QAbstractItemModel>

SignalLog::SignalLog(QObject *parent)
    : QObject(parent)
{
}

QStringList SignalLog::take()
{
    QStringList result;
    result.swap(entries);
    return result;
}

QString SignalLog::describe(const QModelIndex &index, bool withColumn) const
{
    if (!index.isValid())
        return QStringLiteral("root");
    QString text = index.sibling(index.row(), 0).data().toString();
    if (withColumn)
        text += QStringLiteral(":%1").arg(index.column());
    return text;
}

void SignalLog::watchModel(QAbstractItemModel *model)
{
    auto range = [this](const char *what, const QModelIndex &parent, int first, int last) {
        entries.append(QStringLiteral("%1(%2, %3, %4)")
                           .arg(QLatin1String(what), describe(parent))
                           .arg(first)
                           .arg(last));
    };
    connect(model, &QAbstractItemModel::rowsAboutToBeInserted, this,
            [range](const QModelIndex &p, int f, int l) { range("aboutToInsert", p, f, l); });
    connect(model, &QAbstractItemModel::rowsInserted, this,
            [range](const QModelIndex &p, int f, int l) { range("inserted", p, f, l); });
    connect(model, &QAbstractItemModel::rowsAboutToBeRemoved, this,
            [range](const QModelIndex &p, int f, int l) { range("aboutToRemove", p, f, l); });
    connect(model, &QAbstractItemModel::rowsRemoved, this,
            [range](const QModelIndex &p, int f, int l) { range("removed", p, f, l); });
    connect(model, &QAbstractItemModel::dataChanged, this,
            [this](const QModelIndex &tl, const QModelIndex &br) {
                entries.append(QStringLiteral("changed(%1, %2)")
                                   .arg(describe(tl, true), describe(br, true)));
            });
    connect(model, &QAbstractItemModel::modelAboutToBeReset, this,
            [this] { entries.append(QStringLiteral("aboutToReset")); });
    connect(model, &QAbstractItemModel::modelReset, this,
            [this] { entries.append(QStringLiteral("reset")); });
    connect(model, &QAbstractItemModel::layoutChanged, this,
            [this] { entries.append(QStringLiteral("layoutChanged")); });
}

void SignalLog::watchNode(TreeNode *node)
{
    auto id = [](TreeNode *n) { return n ? n->id() : QStringLiteral("null"); };
    auto range = [this, id](const char *what, TreeNode *p, int f, int l) {
        entries.append(QStringLiteral("%1(%2, %3, %4)").arg(QLatin1String(what), id(p)).arg(f).arg(l));
    };
    auto single = [this, id](const char *what, TreeNode *n) {
        entries.append(QStringLiteral("%1(%2)").arg(QLatin1String(what), id(n)));
    };
    connect(node, &TreeNode::nodesAboutToBeInserted, this,
            [range](TreeNode *p, int f, int l) { range("nodesAboutToBeInserted", p, f, l); });
    connect(node, &TreeNode::nodesAboutToBeRemoved, this,
            [range](TreeNode *p, int f, int l) { range("nodesAboutToBeRemoved", p, f, l); });
    connect(node, &TreeNode::nodesInserted, this,
            [this] { entries.append(QStringLiteral("nodesInserted")); });
    connect(node, &TreeNode::nodesRemoved, this,
            [this] { entries.append(QStringLiteral("nodesRemoved")); });
    connect(node, &TreeNode::nodeDataChanged, this,
            [single](TreeNode *n) { single("nodeDataChanged", n); });
    connect(node, &TreeNode::nodeChildsDataChanged, this,
            [single](TreeNode *n) { single("nodeChildsDataChanged", n); });
    connect(node, &TreeNode::setCurrentNode, this,
            [single](TreeNode *n) { single("setCurrentNode", n); });
    connect(node, &TreeNode::expandCurrentNode, this,
            [single](TreeNode *n) { single("expandCurrentNode", n); });
}
