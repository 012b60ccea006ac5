#ifndef KVT_TEST_ELEMENTTREESTRING_H
#define KVT_TEST_ELEMENTTREESTRING_H

#include <kvt-common/elementroottreenode.h>
#include <kvt-common/ordinaryelement.h>

#include "recordingmodule.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QRegularExpression>

// An element showing "<title>:<n>" in column n > 0, with chosen special flags.
class ListedElement : public TestElement<OrdinaryElement>
{
public:
    using TestElement<OrdinaryElement>::TestElement;
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
    explicit ListedRoot(int columns = 1) : columns(columns) {}
    int columnCount() const override { return columns; }
    int columns;
};

/*
 * Element trees in the notation of TreeString ("a[a1 a2] b"), each name being
 * "title[:type][@group][#flags]" for an element (type "user" by default) or
 * "~id[#flags]" for a plain node that is no element:
 * "staff@users[alice bob@admins] ~note s#1".
 */
namespace ElementTreeString {

inline TreeNode *makeNode(Module &module, const QString &name)
{
    static const QRegularExpression pattern(
        QStringLiteral("^(~?)([^:@#~]+)(?::([^@#]+))?(?:@([^#]+))?(?:#(\\d+))?$"));
    const QRegularExpressionMatch m = pattern.match(name);
    if (!m.hasMatch())
        qFatal("not an element tree name: %s", qPrintable(name));
    if (!m.captured(1).isEmpty()) {
        auto *node = new TestTreeNode(m.captured(2), &module);
        node->columns = 3;
        node->specialFlags = m.captured(5).toInt();
        return node;
    }
    auto *element = new ListedElement(module, rightsYes, m.captured(3).isEmpty() ? "user" : m.captured(3),
                                      m.captured(2));
    element->setParent(&module);
    if (!m.captured(4).isEmpty())
        element->setGroupType(m.captured(4));
    element->specialFlags = m.captured(5).toInt();
    return element;
}

// Each subtree is complete before it is hung: one insertion per level.
inline void mirror(Module &module, TreeNode *parent, const TreeNode *pattern)
{
    QList<TreeNode *> nodes;
    for (const TreeNode *child : pattern->childNodes()) {
        nodes.append(makeNode(module, child->id()));
        mirror(module, nodes.last(), child);
    }
    if (!nodes.isEmpty())
        parent->append(nodes);
}

// Builds the description below parent; the nodes belong to the module.
inline void build(Module &module, TreeNode *parent, const QString &description)
{
    TestTreeNode pattern(QStringLiteral("pattern"));
    TreeString::build(&pattern, description);
    mirror(module, parent, &pattern);
}

// The first node below root, depth first, titled (a plain node: with id) name.
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
