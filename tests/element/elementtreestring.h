// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TEST_ELEMENTTREESTRING_H
#define KVT_TEST_ELEMENTTREESTRING_H

#include <kvt-common/elementmodel.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/ordinaryelement.h>

#include "recordingmodule.h"
#include "testtreenode.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QRegularExpression>

#include <memory>
#include <vector>

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

// Element trees in the notation of TreeString ("a[a1 a2] b"), each name being
// "title[:type][@group][#flags]" for an element (type "user" by default) or
// "~id[#flags]" for a plain node that is no element:
// "staff@users[alice bob@admins] ~note s#1".
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

// A described element tree in a module, shown by an element model; the model
// and every proxy stacked on it are watched by QAbstractItemModelTester.
struct ElementTree
{
    using Mode = QAbstractItemModelTester::FailureReportingMode;
    explicit ElementTree(const QString &description, int columns = 1) : root(columns)
    {
        build(&root, description);
        owned.emplace_back(new QAbstractItemModelTester(&model, Mode::QtTest));
    }
    ~ElementTree() { while (!owned.empty()) owned.pop_back(); } // the last proxy first
    // Takes a model (proxy(): a proxy, over source) and watches it.
    template <typename Model>
    Model *own(Model *m)
    {
        owned.emplace_back(m);
        owned.emplace_back(new QAbstractItemModelTester(m, Mode::QtTest));
        return m;
    }
    template <typename Proxy>
    Proxy *proxy(Proxy *p, QAbstractItemModel *source)
    {
        p->setSourceModel(source);
        return own(p);
    }
    void build(TreeNode *parent, const QString &description) { ElementTreeString::build(module, parent, description); }
    TreeNode *node(const QString &name) const { return ElementTreeString::find(&root, name); }
    Element *element(const QString &name) const { return qobject_cast<Element *>(node(name)); }

    RecordingModule module{QStringLiteral("users")};
    ListedRoot root;
    ElementModel model{&root};
    std::vector<std::unique_ptr<QObject>> owned;
};

#endif
