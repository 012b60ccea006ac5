// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "signallog.h"

#include <kvt-common/treenode.h>

#include <QAbstractItemModel>

QString SignalLog::describe(const QModelIndex &index, bool withColumn) const
{
    if (!index.isValid())
        return QStringLiteral("root");
    const QString text = index.sibling(index.row(), 0).data().toString();
    return withColumn ? text + QStringLiteral(":%1").arg(index.column()) : text;
}

void SignalLog::add(const char *what, const QString &who, int first, int last)
{
    entries << QStringLiteral("%1(%2, %3, %4)").arg(QLatin1String(what), who).arg(first).arg(last);
}

void SignalLog::watchModel(QAbstractItemModel *model)
{
    auto range = [=](auto signal, const char *what) {
        connect(model, signal, this, [=](const QModelIndex &p, int f, int l) { add(what, describe(p), f, l); });
    };
    auto plain = [=](auto signal, const char *what) {
        connect(model, signal, this, [=] { entries << QLatin1String(what); });
    };
    range(&QAbstractItemModel::rowsAboutToBeInserted, "aboutToInsert");
    range(&QAbstractItemModel::rowsInserted, "inserted");
    range(&QAbstractItemModel::rowsAboutToBeRemoved, "aboutToRemove");
    range(&QAbstractItemModel::rowsRemoved, "removed");
    connect(model, &QAbstractItemModel::dataChanged, this, [this](const QModelIndex &tl, const QModelIndex &br) {
        entries << QStringLiteral("changed(%1, %2)").arg(describe(tl, true), describe(br, true));
    });
    plain(&QAbstractItemModel::modelAboutToBeReset, "aboutToReset");
    plain(&QAbstractItemModel::modelReset, "reset");
    plain(&QAbstractItemModel::layoutChanged, "layoutChanged");
}

void SignalLog::watchNode(TreeNode *node)
{
    auto id = [](TreeNode *n) { return n ? n->id() : QStringLiteral("null"); };
    auto range = [=](auto signal, const char *what) {
        connect(node, signal, this, [=](TreeNode *p, int f, int l) { add(what, id(p), f, l); });
    };
    auto single = [=](auto signal, const char *what) {
        connect(node, signal, this,
                [=](TreeNode *n) { entries << QStringLiteral("%1(%2)").arg(QLatin1String(what), id(n)); });
    };
    range(&TreeNode::nodesAboutToBeInserted, "nodesAboutToBeInserted");
    range(&TreeNode::nodesAboutToBeRemoved, "nodesAboutToBeRemoved");
    connect(node, &TreeNode::nodesInserted, this, [this] { entries << QStringLiteral("nodesInserted"); });
    connect(node, &TreeNode::nodesRemoved, this, [this] { entries << QStringLiteral("nodesRemoved"); });
    single(&TreeNode::nodeDataChanged, "nodeDataChanged");
    single(&TreeNode::nodeChildsDataChanged, "nodeChildsDataChanged");
    single(&TreeNode::setCurrentNode, "setCurrentNode");
    single(&TreeNode::expandCurrentNode, "expandCurrentNode");
}
