#include <kvt-common/elementsortfilterproxymodel.h>
#include <kvt-common/elementtableview.h>
#include <kvt-common/elementtreeview.h>

#include "elementtreestring.h"

#include <QApplication>
#include <QLineEdit>
#include <QStandardItemModel>
#include <QVBoxLayout>
#include <QtTest>

#include <memory>
#include <utility>

// The element-level signals of a view as readable entries: "structure(bob)"
// (by the display text of the index, "-" when invalid), "focused(bob)",
// "selected(null)", "changed(bob)".
class ViewLog : public QObject
{
    Q_OBJECT

public:
    explicit ViewLog(QAbstractItemView *view)
    {
        connect(view, SIGNAL(currentElementChangedStructure(QModelIndex)), SLOT(structure(QModelIndex)));
        connect(view, SIGNAL(elementContextOperationChangedFocused(Element*)), SLOT(focused(Element*)));
        connect(view, SIGNAL(elementContextOperationChangedSelected(Element*)), SLOT(selected(Element*)));
        connect(view, SIGNAL(elementContextOperationChangedChanged(Element*)), SLOT(changed(Element*)));
    }
    QStringList take() { return std::exchange(entries, QStringList()); }

public Q_SLOTS:
    void structure(const QModelIndex &i) { add("structure", i.isValid() ? i.data().toString() : "-"); }
    void focused(Element *e) { add("focused", e ? e->title() : "null"); }
    void selected(Element *e) { add("selected", e ? e->title() : "null"); }
    void changed(Element *e) { add("changed", e ? e->title() : "null"); }

private:
    void add(const char *what, const QString &text) { entries << QStringLiteral("%1(%2)").arg(what, text); }
    QStringList entries;
};

class ElementViewsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init() { tree.reset(new ElementTree(QStringLiteral("alice bob staff@users[carl dave] eve ~note"), 3)); }
    void cleanup()
    {
        window.reset();
        tree.reset();
    }
    void focusAndSelection_data() { views(); }
    void focusAndSelection();
    void modelChanges_data() { views(); }
    void modelChanges();

private:
    std::unique_ptr<ElementTree> tree;
    std::unique_ptr<QWidget> window; // the view leaves before the models
    QLineEdit *elsewhere = nullptr;
    QAbstractItemView *view = nullptr;
    QAbstractItemModel *shown = nullptr;

    // Each case runs on both views, over the element model itself and over
    // a proxy that sorts it the other way round.
    void views()
    {
        QTest::addColumn<bool>("table");
        QTest::addColumn<bool>("proxy");
        QTest::newRow("table over model") << true << false;
        QTest::newRow("table over proxy") << true << true;
        QTest::newRow("tree over model") << false << false;
        QTest::newRow("tree over proxy") << false << true;
    }
    void show()
    {
        QFETCH(bool, table);
        QFETCH(bool, proxy);
        shown = &tree->model;
        if (proxy) {
            shown = tree->proxy(new ElementSortFilterProxyModel(0), shown);
            shown->sort(0, Qt::DescendingOrder);
        }
        window.reset(new QWidget);
        window->resize(640, 480);
        view = table ? static_cast<QAbstractItemView *>(new ElementTableView) : new ElementTreeView;
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
    }
    void build(const char *parent, const char *description) { tree->build(tree->node(parent), description); }
    void rename(const QString &name, const QString &title) { tree->element(name)->setTitle(title); }
    QModelIndex at(const QString &name, int column = 0)
    {
        const QModelIndex i = dynamic_cast<TreeNodeModelExtension *>(shown)->treeNodeToIndex(tree->node(name));
        return i.sibling(i.row(), column);
    }
    void select(const QString &name, QItemSelectionModel::SelectionFlags how = QItemSelectionModel::ClearAndSelect)
    {
        view->selectionModel()->select(at(name), how | QItemSelectionModel::Rows);
    }
};

void ElementViewsTest::focusAndSelection()
{
    show();
    ViewLog log(view);
    // A click gives the focus before it selects: the focus is reported with
    // the (empty) selection it finds. A cell in column 2 names its row.
    const QRect cell = view->visualRect(at("bob", 2));
    QVERIFY(cell.isValid());
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, cell.center());
    QCOMPARE(log.take(), (QStringList{"focused(null)", "structure(bob)", "selected(bob)"}));
    select("note"); // a row that is no element
    QCOMPARE(log.take(), (QStringList{"structure(note)", "selected(null)"}));
    view->selectionModel()->clearSelection();
    QCOMPARE(log.take(), (QStringList{"structure(-)", "selected(null)"}));

    // Chosen by the program while another widget has the focus: the entry
    // changes, the operations offered stay those of the focused widget.
    elsewhere->setFocus();
    select("eve");
    QCOMPARE(log.take(), QStringList{"structure(eve)"});
    view->setFocus();
    QCOMPARE(log.take(), QStringList{"focused(eve)"});
}

void ElementViewsTest::modelChanges()
{
    // The view has passed through another model over the same tree, and its
    // selection model was replaced: what it has left must reach it no more.
    ElementModel other(&tree->root);
    show();
    QPointer<QItemSelectionModel> first = view->selectionModel();
    view->setModel(&other);
    view->setModel(&other);
    view->setModel(nullptr);
    view->setModel(shown);
    QPointer<QItemSelectionModel> replaced = view->selectionModel();
    view->setSelectionModel(new QItemSelectionModel(shown, window.get()));
    ViewLog log(view);
    first->select(at("eve"), QItemSelectionModel::ClearAndSelect);
    replaced->select(at("eve"), QItemSelectionModel::ClearAndSelect);
    select("staff");
    select("bob", QItemSelectionModel::Select);
    QCOMPARE(log.take(), (QStringList{"structure(staff)", "structure(bob)"}));

    // Rows inserted or removed below a selected row change its structure;
    // elsewhere, and at the top, they do not.
    build("staff", "fred");
    tree->node("staff")->removeOne(tree->node("fred"));
    build("eve", "gus");
    tree->build(&tree->root, QStringLiteral("hal"));
    QCOMPARE(log.take(), (QStringList{"structure(staff)", "structure(staff)"}));
    // Data changes are reported for selected rows only, a change over many
    // rows for the first selected one it meets.
    rename("bob", "bert");
    rename("alice", "ann");
    rename("carl", "cid");
    QCOMPARE(log.take(), QStringList{"changed(bert)"});
    tree->root.emitNodeChildsDataChanged();
    QCOMPARE(log.take(), QStringList{"changed(staff)"});
    // A reset announces the structure with no current entry; the selection
    // it clears is not reported again.
    tree->model.nodesAboutToBeReset();
    other.nodesAboutToBeReset();
    tree->model.nodesReset();
    other.nodesReset();
    QCOMPARE(log.take(), QStringList{"structure(-)"});
    QVERIFY(!view->selectionModel()->hasSelection());

    // A model without elements: only the structure is reported.
    auto *plain = new QStandardItemModel(3, 2, window.get());
    plain->setItem(1, 0, new QStandardItem(QStringLiteral("row1")));
    view->setModel(plain);
    view->setFocus();
    view->selectionModel()->select(plain->index(1, 1), QItemSelectionModel::ClearAndSelect);
    plain->setItem(1, 1, new QStandardItem(QStringLiteral("changed")));
    QCOMPARE(log.take(), QStringList{"structure(row1)"});
}

QTEST_MAIN(ElementViewsTest)

#include "tst_elementviews.moc"
