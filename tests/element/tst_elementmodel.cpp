// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/elementsortfilterproxymodel.h>
#include <kvt-common/filtertreenodesortfilterproxymodel.h>
#include <kvt-common/groupinvisibleelementsortfilterproxymodel.h>
#include <kvt-common/selectableelementsortfilterproxymodel.h>
#include <kvt-common/treenodemodel.h>

#include "elementtreestring.h"
#include "signallog.h"

#include <QStandardItemModel>
#include <QtTest>

class ElementModelTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void cleanup() { tree.reset(); }
    void toElement_data();
    void toElement();
    void groupFilter_data();
    void groupFilter();
    void proxiesFollowLiveTree();

private:
    std::unique_ptr<ElementTree> tree;
};

void ElementModelTest::toElement_data()
{
    QTest::addColumn<QString>("kind");
    QTest::newRow("element model") << "model";
    QTest::newRow("element proxy") << "proxy";
    QTest::newRow("sorted group proxy over element proxy") << "group";
    QTest::newRow("selectable proxy") << "selectable";
}

void ElementModelTest::toElement()
{
    QFETCH(QString, kind);
    tree.reset(new ElementTree(QStringLiteral("staff#2[bob#2 ~note#2] carl#2"), 3));
    QAbstractItemModel *shown = &tree->model;
    if (kind == "proxy" || kind == "group")
        shown = tree->proxy(new ElementSortFilterProxyModel(0), shown);
    if (kind == "group") {
        shown = tree->proxy(new GroupInvisibleElementSortFilterProxyModel, shown);
        shown->sort(0, Qt::DescendingOrder);
    }
    if (kind == "selectable")
        shown = tree->proxy(new SelectableElementSortFilterProxyModel, shown);
    // Views find the extension by a cast from the model they hold.
    auto *extension = dynamic_cast<ElementModelExtension *>(shown);
    QVERIFY(extension);
    for (const char *name : {"staff", "bob", "carl"}) {
        const QModelIndex index = extension->treeNodeToIndex(tree->node(name));
        QCOMPARE(extension->toElement(index.sibling(index.row(), 2)), tree->element(name));
    }
    // A plain node, the root and indexes of other models give no element.
    const QModelIndex note = extension->treeNodeToIndex(tree->node("note"));
    QVERIFY(!extension->toElement(note));
    QVERIFY(!extension->toElement(QModelIndex()));
    QStandardItemModel other(3, 3);
    QVERIFY(!extension->toElement(other.index(0, 0)));
    QVERIFY(kind == "model" || !extension->toElement(tree->model.treeNodeToIndex(tree->node("carl"))));

    // A selection is named by its first range that maps to a node, even a
    // node that is no element; ranges of other models are passed over.
    const QModelIndex carl = extension->treeNodeToIndex(tree->node("carl"));
    QItemSelection selection(other.index(0, 0), other.index(1, 1));
    selection.select(carl.sibling(carl.row(), 1), carl.sibling(carl.row(), 2));
    selection.select(note, note);
    QCOMPARE(extension->toElement(selection), tree->element("carl"));
    selection.prepend(QItemSelectionRange(note));
    QVERIFY(!extension->toElement(selection));
}

void ElementModelTest::groupFilter_data()
{
    QTest::addColumn<QString>("group");
    QTest::addColumn<QString>("expected");
    // staff declares users, bob declares admins; alice, x and the plain node
    // declare nothing; s is hidden by its flags in every case.
    QTest::newRow("Undefined shows every group")
        << "Undefined" << "staff[alice bob[x] note] guests[carl] dave misc[y] note";
    QTest::newRow("a group, inherited by the undefined") << "users" << "staff[alice note] note";
    QTest::newRow("a nested group below another is cut off with its parent")
        << "admins" << "guests[carl] note";
    QTest::newRow("All is an ordinary group name") << "All" << "misc[y] note";
    QTest::newRow("a group nobody has") << "nobody" << "note";
}

void ElementModelTest::groupFilter()
{
    QFETCH(QString, group);
    QFETCH(QString, expected);
    tree.reset(new ElementTree(QStringLiteral("staff@users[alice bob@admins[x] ~note s#1] guests@admins[carl] "
                                              "dave misc@All[y] ~note s#1")));
    auto *base = tree->proxy(new ElementSortFilterProxyModel(1), &tree->model);
    auto *proxy = tree->proxy(new GroupInvisibleElementSortFilterProxyModel, &tree->model);
    QCOMPARE(TreeString::fromModel(proxy), TreeString::fromModel(base)); // Undefined at first
    proxy->setGroupElementType(group);
    QCOMPARE(TreeString::fromModel(proxy), expected);

    // Over a plain tree-node model the same proxy filters by the flags only.
    auto *plain = tree->proxy(new GroupInvisibleElementSortFilterProxyModel, tree->own(new TreeNodeModel(&tree->root)));
    plain->setGroupElementType(group);
    QCOMPARE(TreeString::fromModel(plain), TreeString::fromModel(base));
}

void ElementModelTest::proxiesFollowLiveTree()
{
    tree.reset(new ElementTree(QStringLiteral("staff@users[bob alice#2] guests@admins[carl] sam#1")));
    auto *all = tree->proxy(new ElementSortFilterProxyModel(1), &tree->model);
    auto *users = tree->proxy(new GroupInvisibleElementSortFilterProxyModel, all);
    users->setGroupElementType(QStringLiteral("users"));
    users->sort(0);
    auto *text = tree->proxy(new FilterTreeNodeSortFilterProxyModel(0), users);
    text->setFilterRegExp(QStringLiteral("^[sa]"));
    auto *choice = tree->proxy(new SelectableElementSortFilterProxyModel, &tree->model);
    choice->setSelectionDisplayRole(261);
    auto check = [&](const QString &expected) {
        const QStringList shown{TreeString::fromModel(all), TreeString::fromModel(users),
                                TreeString::fromModel(text), TreeString::fromModel(choice)};
        QCOMPARE(shown.join(" | "), expected);
    };
    check("staff[bob alice] guests[carl] | staff[alice bob] | staff[alice] | ");

    // Insertions: under a group the new element inherits the group. The
    // selectable proxy shows ops, which is hidden too: it does not look at that.
    tree->build(tree->node("guests"), QStringLiteral("dan@users[eve]"));
    tree->build(tree->node("staff"), QStringLiteral("abe:admin#2 zed@admins"));
    tree->build(&tree->root, QStringLiteral("ops@users#3[al#2]"));
    check("staff[bob alice abe zed] guests[carl dan[eve]] | staff[abe alice bob] | staff[abe alice] | user[user]");
    // A moved element takes the group of its new place; a renamed one is
    // sorted and filtered again.
    tree->node("guests")->append(tree->node("bob"));
    tree->element("abe")->setTitle(QStringLiteral("ted"));
    check("staff[alice ted zed] guests[carl dan[eve] bob] | staff[alice ted] | staff[alice] | user[user]");
    tree->node("staff")->removeOne(tree->node("alice"));
    tree->root.removeOne(tree->node("guests"));
    check("staff[ted zed] | staff[ted] | staff | user[user]");

    // Groups are read when rows are filtered: a group changed without any
    // notification is seen only when the filter is forced to run again.
    static_cast<ListedElement *>(tree->node("zed"))->setGroupType(QStringLiteral("users"));
    users->setGroupElementType(QStringLiteral("users"), false);
    QCOMPARE(TreeString::fromModel(users), QStringLiteral("staff[ted]"));
    users->setGroupElementType(QStringLiteral("users"), true);
    QCOMPARE(TreeString::fromModel(users), QStringLiteral("staff[ted zed]"));

    // A whole reload is one reset for every proxy.
    SignalLog log;
    log.watchModel(users);
    tree->model.nodesAboutToBeReset();
    tree->root.clear();
    tree->build(&tree->root, QStringLiteral("sue@users#2 tom@admins#2"));
    tree->model.nodesReset();
    QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
    check("sue tom | sue | sue | user user");
}

QTEST_MAIN(ElementModelTest)

#include "tst_elementmodel.moc"
