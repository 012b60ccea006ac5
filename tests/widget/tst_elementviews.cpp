// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/elementsortfilterproxymodel.h>
#include <kvt-common/elementtableview.h>
#include <kvt-common/elementtreeview.h>

#include "elementtreestring.h"

#include <QtTest>
#include <QtWidgets>

#include <memory>
#include <utility>

class ElementViewsTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<ElementTree> tree;
    std::unique_ptr<QWidget> window; // the view leaves before the models
    QLineEdit *elsewhere = nullptr;
    QAbstractItemView *view = nullptr;
    QAbstractItemModel *shown = nullptr;
    // The element-level signals of the view: "structure(bob)" (by the display
    // text of the index, "-" when invalid), "focused(bob)", "selected(null)", "changed(bob)".
    QStringList log;

    QStringList take() { return std::exchange(log, QStringList()); }
    template <class View>
    View *watched(View *view)
    {
        const auto element = [this](const char *what) {
            return [this, what](Element *e) { log.append(QStringLiteral("%1(%2)").arg(what, e ? e->title() : "null")); };
        };
        connect(view, &View::currentElementChangedStructure, this, [this](const QModelIndex &i) {
            log.append(QStringLiteral("structure(%1)").arg(i.isValid() ? i.data().toString() : "-"));
        });
        connect(view, &View::elementContextOperationChangedFocused, this, element("focused"));
        connect(view, &View::elementContextOperationChangedSelected, this, element("selected"));
        connect(view, &View::elementContextOperationChangedChanged, this, element("changed"));
        return view;
    }
    // Each case runs on both views, one over the element model itself, one
    // over a proxy that sorts it the other way round.
    void views()
    {
        QTest::addColumn<bool>("table");
        QTest::addColumn<bool>("proxy");
        QTest::newRow("table over model") << true << false;
        QTest::newRow("tree over proxy") << false << true;
    }
    void show()
    {
        QFETCH(bool, table);
        QFETCH(bool, proxy);
        shown = proxy ? static_cast<QAbstractItemModel *>(tree->proxy(new ElementSortFilterProxyModel(0), &tree->model)) : &tree->model;
        if (proxy)
            shown->sort(0, Qt::DescendingOrder);
        window.reset(new QWidget);
        window->resize(640, 480);
        view = table ? static_cast<QAbstractItemView *>(watched(new ElementTableView)) : watched(new ElementTreeView);
        QCOMPARE(view->contextMenuPolicy(), Qt::CustomContextMenu); // menus are the host's
        auto *layout = new QVBoxLayout(window.get());
        layout->addWidget(elsewhere = new QLineEdit);
        layout->addWidget(view);
        view->setModel(shown);
        window->show();
        QApplication::setActiveWindow(window.get());
        QVERIFY(QTest::qWaitForWindowActive(window.get()));
        elsewhere->setFocus();
        QTRY_VERIFY(elsewhere->hasFocus());
        take();
    }
    QModelIndex at(const QString &name, int column = 0)
    {
        const QModelIndex i = dynamic_cast<TreeNodeModelExtension *>(shown)->treeNodeToIndex(tree->node(name));
        return i.sibling(i.row(), column);
    }
    void select(const QString &name, QItemSelectionModel::SelectionFlags how = QItemSelectionModel::ClearAndSelect)
    {
        view->selectionModel()->select(at(name), how | QItemSelectionModel::Rows);
    }

private Q_SLOTS:
    void init() { tree.reset(new ElementTree(QStringLiteral("alice bob staff@users[carl dave] eve ~note"), 3)); }
    void cleanup()
    {
        window.reset();
        tree.reset();
    }

    void focusAndSelection_data() { views(); }
    void focusAndSelection()
    {
        show();
        // A click gives the focus before it selects: the focus is reported
        // with the (empty) selection it finds. A cell in column 2 names its row.
        const QRect cell = view->visualRect(at("bob", 2));
        QVERIFY(cell.isValid());
        QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, cell.center());
        QCOMPARE(take(), (QStringList{"focused(null)", "structure(bob)", "selected(bob)"}));
        select("note"); // a row that is no element
        QCOMPARE(take(), (QStringList{"structure(note)", "selected(null)"}));
        // Chosen by the program while another widget has the focus: the entry
        // changes, the operations offered stay those of the focused widget.
        elsewhere->setFocus();
        select("eve");
        QCOMPARE(take(), QStringList{"structure(eve)"});
        view->setFocus();
        QCOMPARE(take(), QStringList{"focused(eve)"});
    }

    void modelChanges_data() { views(); }
    void modelChanges()
    {
        // The view has passed through another model over the same tree, and its
        // selection model was replaced: what it has left must reach it no more.
        ElementModel other(&tree->root);
        show();
        QPointer<QItemSelectionModel> first = view->selectionModel();
        view->setModel(&other);
        view->setModel(nullptr);
        view->setModel(shown);
        QPointer<QItemSelectionModel> replaced = view->selectionModel();
        view->setSelectionModel(new QItemSelectionModel(shown, window.get()));
        take();
        first->select(at("eve"), QItemSelectionModel::ClearAndSelect);
        replaced->select(at("eve"), QItemSelectionModel::ClearAndSelect);
        select("staff");
        select("bob", QItemSelectionModel::Select);
        QCOMPARE(take(), (QStringList{"structure(staff)", "structure(bob)"}));

        // Rows inserted or removed below a selected row change its structure;
        // elsewhere, and at the top, they do not.
        tree->build(tree->node("staff"), "fred");
        tree->node("staff")->removeOne(tree->node("fred"));
        tree->build(tree->node("eve"), "gus");
        tree->build(&tree->root, QStringLiteral("hal"));
        QCOMPARE(take(), (QStringList{"structure(staff)", "structure(staff)"}));
        // Data changes are reported for selected rows only, a change over
        // many rows for the first selected one it meets.
        for (const char *name : {"bob", "alice", "carl"})
            tree->element(name)->setTitle(QString::fromLatin1(name).toUpper());
        QCOMPARE(take(), QStringList{"changed(BOB)"});
        tree->root.emitNodeChildsDataChanged();
        QCOMPARE(take(), QStringList{"changed(staff)"});
        // A reset announces the structure with no current entry; the
        // selection it clears is not reported again.
        tree->model.nodesAboutToBeReset();
        other.nodesAboutToBeReset();
        tree->model.nodesReset();
        other.nodesReset();
        QCOMPARE(take(), QStringList{"structure(-)"});
        QVERIFY(!view->selectionModel()->hasSelection());
    }
};

QTEST_MAIN(ElementViewsTest)
#include "tst_elementviews.moc"
