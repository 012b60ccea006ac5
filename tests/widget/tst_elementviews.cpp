#include <kvt-common/elementmodel.h>
#include <kvt-common/elementsortfilterproxymodel.h>
#include <kvt-common/elementtableview.h>
#include <kvt-common/elementtreeview.h>

#include "elementtreestring.h"

#include <QAbstractItemModelTester>
#include <QApplication>
#include <QHeaderView>
#include <QLineEdit>
#include <QStandardItemModel>
#include <QVBoxLayout>
#include <QtTest>

#include <memory>
#include <utility>

using Tester = QAbstractItemModelTester;

// The element-level signals of a view as readable entries: "structure(bob:0)"
// (a row by the text of its column 0 and the index's column, "-" when
// invalid), "focused(bob)", "selected(null)", "changed(bob)".
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
    void structure(const QModelIndex &i)
    {
        const QString row = i.sibling(i.row(), 0).data().toString();
        add("structure", i.isValid() ? QStringLiteral("%1:%2").arg(row).arg(i.column()) : "-");
    }
    void focused(Element *e) { add("focused", e); }
    void selected(Element *e) { add("selected", e); }
    void changed(Element *e) { add("changed", e); }

private:
    void add(const char *what, Element *e) { add(what, e ? e->title() : QStringLiteral("null")); }
    void add(const char *what, const QString &text)
    {
        entries.append(QStringLiteral("%1(%2)").arg(QLatin1String(what), text));
    }
    QStringList entries;
};

class ElementViewsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();

    void construction();
    void focusAndSelection_data() { views(); }
    void focusAndSelection();
    void modelChanges_data() { views(); }
    void modelChanges();
    void modelReplaced_data() { views(); }
    void modelReplaced();
    void modelWithoutElements_data() { views(); }
    void modelWithoutElements();

private:
    std::unique_ptr<RecordingModule> module;
    std::unique_ptr<ListedRoot> root;
    std::unique_ptr<ElementModel> model;
    std::vector<std::unique_ptr<QObject>> keep; // destroyed first
    QWidget *window = nullptr;
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
        shown = model.get();
        if (proxy) {
            auto *sorted = new ElementSortFilterProxyModel(0);
            sorted->setSourceModel(model.get());
            sorted->sort(0, Qt::DescendingOrder);
            keep.emplace_back(new Tester(sorted, Tester::FailureReportingMode::QtTest));
            keep.emplace_back(sorted);
            shown = sorted;
        }
        view = table ? static_cast<QAbstractItemView *>(new ElementTableView(window))
                     : new ElementTreeView(window);
        window->layout()->addWidget(view);
        view->setModel(shown);
        window->show();
        QApplication::setActiveWindow(window);
        QVERIFY(QTest::qWaitForWindowActive(window));
        elsewhere->setFocus();
        QTRY_VERIFY(elsewhere->hasFocus());
    }
    TreeNode *find(const QString &name) { return ElementTreeString::find(root.get(), name); }
    void rename(const QString &name, const QString &title)
    {
        qobject_cast<Element *>(find(name))->setTitle(title);
    }
    QModelIndex at(const QString &name, int column = 0)
    {
        TreeNode *node = find(name);
        const QModelIndex i = dynamic_cast<TreeNodeModelExtension *>(shown)->treeNodeToIndex(node);
        return i.sibling(i.row(), column);
    }
    void select(const QString &name,
                QItemSelectionModel::SelectionFlags how = QItemSelectionModel::ClearAndSelect)
    {
        view->selectionModel()->select(at(name), how | QItemSelectionModel::Rows);
    }
};

void ElementViewsTest::init()
{
    module.reset(new RecordingModule(QStringLiteral("users")));
    root.reset(new ListedRoot(3));
    ElementTreeString::build(*module, root.get(),
                             QStringLiteral("alice bob staff@users[carl dave] eve ~note"));
    model.reset(new ElementModel(root.get()));
    keep.emplace_back(new Tester(model.get(), Tester::FailureReportingMode::QtTest));
    window = new QWidget;
    window->resize(640, 480);
    new QVBoxLayout(window);
    elsewhere = new QLineEdit(window);
    window->layout()->addWidget(elsewhere);
}

void ElementViewsTest::cleanup()
{
    delete window;
    while (!keep.empty())
        keep.pop_back();
    model.reset();
    root.reset();
    module.reset();
}

void ElementViewsTest::construction()
{
    ElementTableView table;
    ElementTreeView tree;
    QCOMPARE(table.contextMenuPolicy(), Qt::CustomContextMenu);
    QCOMPARE(tree.contextMenuPolicy(), Qt::CustomContextMenu);
    QCOMPARE(table.horizontalHeader()->defaultAlignment(), Qt::Alignment(Qt::AlignLeft));
}

void ElementViewsTest::focusAndSelection()
{
    show();
    ViewLog log(view);
    // A click gives the focus before it selects: the focus is reported with
    // the (empty) selection it finds. A cell in column 2 names its row.
    const QRect cell = view->visualRect(at("bob", 2));
    QVERIFY(cell.isValid());
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, cell.center());
    QCOMPARE(log.take(), (QStringList{"focused(null)", "structure(bob:0)", "selected(bob)"}));
    select("note"); // a row that is no element
    QCOMPARE(log.take(), (QStringList{"structure(note:0)", "selected(null)"}));
    view->selectionModel()->clearSelection();
    QCOMPARE(log.take(), (QStringList{"structure(-)", "selected(null)"}));

    // Chosen by the program while another widget has the focus: the entry
    // changes, the operations offered stay those of the focused widget.
    elsewhere->setFocus();
    select("eve");
    QCOMPARE(log.take(), QStringList{"structure(eve:0)"});
    view->setFocus();
    QCOMPARE(log.take(), QStringList{"focused(eve)"});
}

void ElementViewsTest::modelChanges()
{
    show();
    select("staff");
    select("bob", QItemSelectionModel::Select);
    ViewLog log(view);
    // Rows inserted or removed below a selected row change its structure;
    // elsewhere, and at the top, they do not.
    ElementTreeString::build(*module, find("staff"), QStringLiteral("fred"));
    find("staff")->removeOne(find("fred"));
    ElementTreeString::build(*module, find("eve"), QStringLiteral("gus"));
    ElementTreeString::build(*module, root.get(), QStringLiteral("hal"));
    QCOMPARE(log.take(), (QStringList{"structure(staff:0)", "structure(staff:0)"}));

    // Data changes are reported for selected rows only, a change over many
    // rows for the first selected one it meets.
    rename("bob", "bert");
    rename("alice", "ann");
    rename("carl", "cid");
    QCOMPARE(log.take(), QStringList{"changed(bert)"});
    root->emitNodeChildsDataChanged();
    QCOMPARE(log.take(), QStringList{"changed(staff)"});

    // A reset announces the structure with no current entry; the selection
    // it clears is not reported again.
    model->nodesAboutToBeReset();
    model->nodesReset();
    QCOMPARE(log.take(), QStringList{"structure(-)"});
    QVERIFY(!view->selectionModel()->hasSelection());
}

void ElementViewsTest::modelReplaced()
{
    // A second model over the same tree: once the view has left it, its
    // signals must reach the view no more.
    ElementModel other(root.get());
    show();
    QPointer<QItemSelectionModel> firstSelection = view->selectionModel();
    view->setModel(&other);
    view->setModel(&other);
    view->setModel(nullptr);
    view->setModel(shown);
    QPointer<QItemSelectionModel> replaced = view->selectionModel();
    QItemSelectionModel shared(shown);
    view->setSelectionModel(&shared);
    view->setFocus();
    ViewLog log(view);

    firstSelection->select(at("bob"), QItemSelectionModel::ClearAndSelect);
    replaced->select(at("eve"), QItemSelectionModel::ClearAndSelect);
    QCOMPARE(log.take(), QStringList());
    select("staff");
    QCOMPARE(log.take(), (QStringList{"structure(staff:0)", "selected(staff)"}));
    ElementTreeString::build(*module, find("staff"), QStringLiteral("fred"));
    QCOMPARE(log.take(), QStringList{"structure(staff:0)"});
    rename("staff", "crew");
    QCOMPARE(log.take(), QStringList{"changed(crew)"});
    model->nodesAboutToBeReset();
    other.nodesAboutToBeReset();
    model->nodesReset();
    other.nodesReset();
    QCOMPARE(log.take(), QStringList{"structure(-)"});
    delete window; // the view leaves before the models and the shared selection
    window = nullptr;
}

void ElementViewsTest::modelWithoutElements()
{
    QStandardItemModel plain(3, 2);
    for (int row = 0; row < 3; ++row) {
        plain.setItem(row, 0, new QStandardItem(QStringLiteral("row%1").arg(row)));
        plain.setItem(row, 1, new QStandardItem(QStringLiteral("more")));
    }
    show();
    view->setModel(&plain);
    ViewLog log(view);
    view->setFocus();
    view->selectionModel()->select(plain.index(1, 1), QItemSelectionModel::ClearAndSelect);
    plain.item(1, 1)->setText(QStringLiteral("changed"));
    QCOMPARE(log.take(), QStringList{"structure(row1:0)"});
    delete window;
    window = nullptr;
}

QTEST_MAIN(ElementViewsTest)

#include "tst_elementviews.moc"
