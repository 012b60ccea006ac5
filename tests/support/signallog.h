// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TEST_SIGNALLOG_H
#define KVT_TEST_SIGNALLOG_H

#include <QModelIndex>
#include <QObject>
#include <QStringList>

#include <utility>

class QAbstractItemModel;
class TreeNode;

/*!
 * Records signals as readable strings so that a whole sequence is compared in
 * one QCOMPARE:
 *
 *   model signals: "aboutToInsert(root, 2, 2)", "inserted(root, 2, 2)",
 *                  "aboutToRemove(a, 0, 1)", "removed(a, 0, 1)",
 *                  "changed(a:0, a:1)", "aboutToReset", "reset"
 *   node signals:  "nodesAboutToBeInserted(a, 0, 0)", "nodesInserted",
 *                  "nodesAboutToBeRemoved(a, 0, 0)", "nodesRemoved",
 *                  "nodeDataChanged(a)", "nodeChildsDataChanged(a)",
 *                  "setCurrentNode(a)", "expandCurrentNode(a)"
 *
 * An index is written as the text of its row's column 0 ("root" when
 * invalid), followed by ":column" where the column matters; a node by its id.
 */
class SignalLog : public QObject
{
    Q_OBJECT

public:
    using QObject::QObject;

    void watchModel(QAbstractItemModel *model);
    void watchNode(TreeNode *node);

    QStringList entries;
    QStringList take() { return std::exchange(entries, QStringList()); }

private:
    QString describe(const QModelIndex &index, bool withColumn = false) const;
    void add(const char *what, const QString &who, int first, int last);
};

#endif
