#ifndef KVT_TEST_TESTTREENODE_H
#define KVT_TEST_TESTTREENODE_H

#include <kvt-common/treenode.h>

#include <QStringList>

/*!
 * A node for tests: shows its id in column 0 and "<id>:<column>" in the other
 * columns, accepts edits of column 0 (the edit becomes its display text), and
 * lets a test choose its column count, special flags and lazy loading.
 */
class TestTreeNode : public TreeNode
{
    Q_OBJECT

public:
    explicit TestTreeNode(const QString &id, QObject *parent = nullptr);
    TestTreeNode(const QString &id, int expectedDepth, const QString &expectedParentId,
                 QObject *parent = nullptr);
    ~TestTreeNode() override;

    int columnCount() const override { return columns; }
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override;
    QVariant data(int column, int role) const override;
    bool setData(int column, const QVariant &value, int role) override;
    int treeNodeSpecialFlags() const override { return specialFlags; }
    bool canFetchMore() const override { return fetchable; }
    void fetchMore() override;
    void afterLoad() override;

    int columns = 2;
    int specialFlags = 0;
    bool fetchable = false;
    QString text;
    QStringList *afterLoadLog = nullptr; // appended with the id on afterLoad()
    int *destructionCount = nullptr;     // incremented by the destructor
};

#endif
