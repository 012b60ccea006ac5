// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TEST_TESTTREENODE_H
#define KVT_TEST_TESTTREENODE_H

#include <kvt-common/treenode.h>

#include <QStringList>

/*!
 * A node for tests: shows its id in column 0 and "<id>:<column>" in the other
 * columns, accepts edits of column 0 (the edit becomes its display text), and
 * lets a test choose its column count, special flags and whether it can fetch
 * more, record afterLoad() calls and count destructions.
 */
class TestTreeNode : public TreeNode
{
    Q_OBJECT

public:
    explicit TestTreeNode(const QString &id, QObject *parent = nullptr, int expectedDepth = -1,
                          const QString &expectedParentId = QString());
    ~TestTreeNode() override { if (destructionCount) ++*destructionCount; }

    int columnCount() const override { return columns; }
    QVariant data(int column, int role) const override;
    bool setData(int column, const QVariant &value, int role) override;
    int treeNodeSpecialFlags() const override { return specialFlags; }
    void afterLoad() override { if (afterLoadLog) afterLoadLog->append(id()); }
    bool canFetchMore() const override { return fetchable; }

    int columns = 2;
    int specialFlags = 0;
    bool fetchable = false;
    QString text;
    QStringList *afterLoadLog = nullptr; // appended with the id on afterLoad()
    int *destructionCount = nullptr;     // incremented by the destructor
};

#endif
