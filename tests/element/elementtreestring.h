#ifndef KVT_TEST_ELEMENTTREESTRING_H
#define KVT_TEST_ELEMENTTREESTRING_H

#include <kvt-common/elementroottreenode.h>
#include <kvt-common/ordinaryelement.h>

#include "recordingmodule.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QRegularExpression>

/*!
 * Element trees written as strings, for the element model and view tests.
 *
 * The notation is that of TreeString ("a[a1 a2] b"); each name is
 *   title[:type][@group][#flags]
 * for an element (type "user" unless given, group undefined unless given,
 * special flags 0 unless given), or "~id[#flags]" for a plain TreeNode that is
 * not an element. "staff@users[alice bob@admins] ~note s#1" is a group element
 * staff of the group users holding alice and bob, a plain node and an
 * element s marked hidden.
 */

// An element that shows "<title>:<n>" in the columns after the first and
// answers the special flags it is given.
class ListedElement : public TestElement<OrdinaryElement>
{
public:
    ListedElement(Module &module, const QString &type, const QString &title)
        : TestElement<OrdinaryElement>(module, rightsYes, type, title)
    {
    }

    QVariant data(int column, int role) const override
    {
        if (column > 0 && role == Qt::DisplayRole)
            return QStringLiteral("%1:%2").arg(title()).arg(column);
        return TestElement<OrdinaryElement>::data(column, role);
    }
    int treeNodeSpecialFlags() const override { return specialFlags; }

    int specialFlags = 0;
};

// The root of an element tree with a chosen number of columns.
class ListedRoot : public ElementRootTreeNode
{
public:
    explicit ListedRoot(int columns = 1)
        : columns(columns)
    {
    }

    int columnCount() const override { return columns; }
    QVariant headerData(int section, Qt::Orientation orientation, int role) const override
    {
        if (section > 0 && orientation == Qt::Horizontal && role == Qt::DisplayRole)
            return QStringLiteral("column %1").arg(section);
        return ElementRootTreeNode::headerData(section, orientation, role);
    }

    int columns;
};

namespace ElementTreeString {

inline TreeNode *makeNode(Module &module, const QString &name)
{
    static const QRegularExpression pattern(
        QStringLiteral("^(~?)([^:@#~]+)(?::([^@#]+))?(?:@([^#]+))?(?:#(\\d+))?$"));
    const QRegularExpressionMatch match = pattern.match(name);
    if (!match.hasMatch())
        qFatal("not an element tree name: %s", qPrintable(name));
    if (!match.captured(1).isEmpty()) {
        auto *node = new TestTreeNode(match.captured(2), &module);
        node->columns = 3;
        node->specialFlags = match.captured(5).toInt();
        return node;
    }
    const QString type = match.captured(3).isEmpty() ? QStringLiteral("user") : match.captured(3);
    auto *element = new ListedElement(module, type, match.captured(2));
    element->setParent(&module);
    if (!match.captured(4).isEmpty())
        element->setGroupType(match.captured(4));
    element->specialFlags = match.captured(5).toInt();
    return element;
}

// Every subtree is complete before it is hung, so each level is one
// insertion.
inline void mirror(Module &module, TreeNode *parent, const TreeNode *pattern)
{
    QList<TreeNode *> nodes;
    for (const TreeNode *child : pattern->childNodes()) {
        TreeNode *node = makeNode(module, child->id());
        mirror(module, node, child);
        nodes.append(node);
    }
    if (!nodes.isEmpty())
        parent->append(nodes);
}

/*! Builds \a description below \a parent; the new nodes belong (as QObjects)
 *  to \a module. */
inline void build(Module &module, TreeNode *parent, const QString &description)
{
    TestTreeNode pattern(QStringLiteral("pattern"));
    TreeString::build(&pattern, description);
    mirror(module, parent, &pattern);
}

/*! The node below \a root whose title (or, for a plain node, id) is
 *  \a name, searched depth first; null if there is none. */
inline TreeNode *find(const TreeNode *root, const QString &name)
{
    for (TreeNode *child : root->childNodes()) {
        const auto *element = qobject_cast<const Element *>(child);
        if (element ? element->title() == name : child->id() == name)
            return child;
        if (TreeNode *found = find(child, name))
            return found;
    }
    return nullptr;
}

} // namespace ElementTreeString

#endif
