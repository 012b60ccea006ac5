// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// The code snippets of README.md and docs/mainpage.md, compiled as they stand
// (extractsnippets copies them out at build time) and run: the tree snippet
// shows its rows, the host snippet loads the plugin built from the plugin
// snippets, the widget snippet shows an element's widget, and the worker
// snippet's task really runs and hands its record to that widget.

#include "globalsnippets.h"

#include <kvt-common/vieweditelementwidget.h>

#include <QAbstractItemModelTester>
#include <QPointer>
#include <QTemporaryDir>
#include <QTest>
#include <QTreeView>

#include "read-task.inc"

namespace {

// The edit widget a plugin registers for greetings; keeps what a read hands it.
class GreetingWidget : public ViewEditElementWidget
{
public:
    explicit GreetingWidget(Module &module)
        : ViewEditElementWidget(module, Module::defaultTrue)
    {
        _elementType = QStringLiteral("greeting");
    }
    QString toolTipText() const override { return QString(); }
    void afterSuccessfulRead(Element *element, ElementData *data) override
    {
        readText = data ? data->value(QStringLiteral("text")).toString() : QStringLiteral("<no record>");
        ViewEditElementWidget::afterSuccessfulRead(element, data);
    }
    QString readText;
};

} // namespace

class TestSnippets : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void treeModel();
    void hostWidgetsAndTasks();
};

void TestSnippets::treeModel()
{
    QTreeView treeView;
    QTreeView *view = &treeView;
#include "tree-model.inc"
    QAbstractItemModelTester tester(&model, QAbstractItemModelTester::FailureReportingMode::QtTest);

    QCOMPARE(model.rowCount(), 2);
    QCOMPARE(model.headerData(1, Qt::Horizontal).toString(), QStringLiteral("Value"));
    // Siblings are ordered by id: Conf_host_localhost before Conf_port_5432.
    QCOMPARE(model.index(0, 0).data().toString(), QStringLiteral("host"));
    QCOMPARE(model.index(1, 1).data().toString(), QStringLiteral("5432"));
    QCOMPARE(view->model(), &model);
}

void TestSnippets::hostWidgetsAndTasks()
{
    QWidget window;
    QWidget *mainWindow = &window;
    QTreeView moduleTree;
    QTreeView *moduleView = &moduleTree;
    ElementTreeView elementTree;
    ElementTreeView *elementView = &elementTree;
    const QString pluginDirectory = QStringLiteral(KVT_SNIPPET_PLUGIN_DIR);

#include "host-load.inc"
    QAbstractItemModelTester moduleTester(plugins.treeNodeModel(),
                                          QAbstractItemModelTester::FailureReportingMode::QtTest);
    QAbstractItemModelTester elementTester(elements.treeNodeModel(),
                                           QAbstractItemModelTester::FailureReportingMode::QtTest);

    // The plugin of the plugin snippet was found, accepted and laid out.
    QCOMPARE(plugins.plugins().size(), 1);
    QVERIFY2(plugins.plugins().first().second, qPrintable(plugins.pluginError(0)));
    QCOMPARE(plugins.plugins().first().second->name(), QStringLiteral("Hello"));
    QCOMPARE(plugins.modules().size(), 1);
    auto *module = qobject_cast<Module *>(plugins.modules().first());
    QVERIFY(module);
    QCOMPARE(moduleView->model()->index(0, 0).data().toString(), QStringLiteral("hello"));
    QCOMPARE(elements.treeNodeModel()->rowCount(), 1);

    auto *widget = new GreetingWidget(*module);
    QPointer<GreetingWidget> widgetGuard(widget);
    module->insertElementWidget(widget);

    {
#include "mainpage-widgets.inc"
        QScopedPointer<ElementTreeView> viewOwner(view);
        QScopedPointer<ElementWidgetContainer2> panelOwner(panel);

        // Selecting the element in the view shows its widget in the panel.
        const QModelIndex first = elements.treeNodeModel()->index(0, 0);
        auto *element = qobject_cast<Element *>(elements.treeNodeModel()->toTreeNode(first));
        QVERIFY(element);
        view->setCurrentIndex(first);
        QCOMPARE(panel->currentElementWidget(), widget);
        QCOMPARE(widget->element(), element);

        // The worker snippet: its task runs on a worker (it is not refused)
        // and its record reaches the edit widget.
        QTemporaryDir dir;
        QFile file(dir.filePath(QStringLiteral("greeting.txt")));
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.write("Hello from a file");
        file.close();
        element->elementData()->insert(QStringLiteral("file"), file.fileName());
        {
#include "workers.inc"
            QTRY_COMPARE(widget->readText, QStringLiteral("Hello from a file"));
            QCOMPARE(TaskObserver::instance()->problemCount(), 0);
            QTRY_COMPARE(TaskObserver::instance()->runningCount(), 0);

            // The module's own read path: the element asks its module, which
            // starts the task of the plugin snippet.
            widget->readText.clear();
            file.remove();
            element->performOperation(ReadPropertyOperation, nullptr, 0);
            QTRY_COMPARE(TaskObserver::instance()->problemCount(), 1);
            QVERIFY(widget->readText.isEmpty()); // a failed read hands nothing over
            TaskObserver::instance()->clearTasks();
        }

        // A reload deletes the module and its widget: the panel hands the
        // widget back first and is empty afterwards.
        plugins.loadPlugins(pluginDirectory);
        QVERIFY(widgetGuard.isNull());
        QCOMPARE(panel->currentElementWidget(), nullptr);
        QCOMPARE(elements.treeNodeModel()->rowCount(), 1);
    }
}

QTEST_MAIN(TestSnippets)
#include "tst_snippets.moc"
