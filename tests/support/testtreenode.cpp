#include "testtreenode.h"

TestTreeNode::TestTreeNode(const QString &id, QObject *parent)
    : TreeNode(parent)
{
    setId(id);
}

TestTreeNode::TestTreeNode(const QString &id, int expectedDepth, const QString &expectedParentId,
                           QObject *parent)
    : TreeNode(expectedDepth, expectedParentId, parent)
{
    setId(id);
}

TestTreeNode::~TestTreeNode()
{
    if (destructionCount)
        ++*destructionCount;
}

QVariant TestTreeNode::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (orientation == Qt::Horizontal && role == Qt::DisplayRole && section < columns)
        return QStringLiteral("column %1").arg(section);
    return TreeNode::headerData(section, orientation, role);
}

QVariant TestTreeNode::data(int column, int role) const
{
    if (role == Qt::DisplayRole || role == Qt::EditRole) {
        const QString shown = text.isEmpty() ? id() : text;
        return column == 0 ? shown : QStringLiteral("%1:%2").arg(shown).arg(column);
    }
    return TreeNode::data(column, role);
}

bool TestTreeNode::setData(int column, const QVariant &value, int role)
{
    if (column != 0 || role != Qt::EditRole)
        return false;
    text = value.toString();
    return true;
}

void TestTreeNode::fetchMore()
{
    // Views and the model tester may ask more than once.
    if (!fetchable)
        return;
    fetchable = false;
    append(new TestTreeNode(id() + QStringLiteral(".lazy"), this));
}

void TestTreeNode::afterLoad()
{
    if (afterLoadLog)
        afterLoadLog->append(id());
}
