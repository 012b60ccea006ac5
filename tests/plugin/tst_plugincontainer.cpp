#include <kvt-common/elementcontainer.h>
#include <kvt-common/module.h>
#include <kvt-common/plugin.h>
#include <kvt-common/plugincontainer.h>
#include <kvt-common/plugindialog.h>
#include <kvt-common/pluginmodel.h>
#include <kvt-common/treenodemodel.h>

#include "dialoganswerer.h"
#include "signallog.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QApplication>
#include <QDialogButtonBox>
#include <QLineEdit>
#include <QPushButton>
#include <QSettings>
#include <QSignalSpy>
#include <QTemporaryDir>
#include <QTreeView>
#include <QtTest>

#include <memory>

Q_DECLARE_METATYPE(const TreeNode *)

namespace {

const QString pluginDir = QStringLiteral(KVT_TEST_PLUGIN_DIR);
const QStringList oneReset{"aboutToReset", "reset"};

// Guards on the plugins a container accepted: null once a plugin is gone.
QList<QPointer<Plugin>> acceptedPlugins(const PluginContainer &container)
{
    QList<QPointer<Plugin>> accepted;
    for (const PluginContainer::PluginEntry &entry : container.plugins())
        if (entry.second)
            accepted.append(entry.second);
    return accepted;
}

// The container keeps its dialog to itself: found by the model it shows.
PluginDialog *dialogOf(const PluginContainer &container)
{
    for (QWidget *widget : QApplication::allWidgets()) {
        auto *dialog = qobject_cast<PluginDialog *>(widget);
        auto *view = dialog ? dialog->findChild<QTreeView *>(QStringLiteral("_pluginTtreeView")) : nullptr;
        if (view && view->model() == container.pluginModel())
            return dialog;
    }
    return nullptr;
}

} // namespace

class PluginContainerTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<PluginContainer> container;
    std::unique_ptr<QAbstractItemModelTester> pluginModelTester, moduleModelTester;
    SignalLog *pluginModelLog = nullptr;

private Q_SLOTS:
    void initTestCase() { qRegisterMetaType<const TreeNode *>(); }

    void init()
    {
        container.reset(new PluginContainer);
        const auto mode = QAbstractItemModelTester::FailureReportingMode::QtTest;
        pluginModelTester.reset(new QAbstractItemModelTester(container->pluginModel(), mode));
        moduleModelTester.reset(new QAbstractItemModelTester(container->treeNodeModel(), mode));
        pluginModelLog = new SignalLog(container.get());
        pluginModelLog->watchModel(container->pluginModel());
    }

    void cleanup()
    {
        pluginModelTester.reset();
        moduleModelTester.reset();
        container.reset();
        while (QApplication::overrideCursor())
            QApplication::restoreOverrideCursor();
        QSettings().clear();
    }

    void loadAndUnload_data()
    {
        QTest::addColumn<QStringList>("files"); // "from=to", copied into a directory; none: the whole tree
        QTest::addColumn<QString>("tree");
        QTest::addColumn<quint64>("mask");
        QTest::addColumn<QString>("plugins"); // accepted of tried

        QTest::newRow("every kind of file")
            << QStringList() << "alpha[alpha-child] beta delta" << quint64(7) << "4 of 7";
        // A plugin adds its mask only with a module.
        QTest::newRow("masks 1 and 4, 16 without a module")
            << QStringList{"valid.so", "masked.so", "nomodules.so"} << "alpha[alpha-child] beta" << quint64(5)
            << "3 of 3";
        QTest::newRow("refused, and not named *.so")
            << QStringList{"invalid.so", "otherinterface.so", "broken.so", "broken.so=readme.txt", "broken.so=lib.so.1"}
            << "" << quint64(0) << "0 of 3";
        QTest::newRow("deep in subdirectories")
            << QStringList{"sub/nested.so=a/b/c/nested.so"} << "delta" << quint64(2) << "1 of 1";
    }

    void loadAndUnload()
    {
        QFETCH(QStringList, files);
        QFETCH(QString, tree);
        QFETCH(quint64, mask);
        QFETCH(QString, plugins);

        QTemporaryDir own;
        const QString directory = files.isEmpty() ? pluginDir : own.path();
        for (const QString &file : files) {
            const QString to = own.filePath(file.section(QLatin1Char('='), -1));
            QVERIFY(QDir().mkpath(QFileInfo(to).path()));
            QVERIFY(QFile::copy(pluginDir + QLatin1Char('/') + file.section(QLatin1Char('='), 0, 0), to));
        }
        // Loaded twice: the second load replaces the first, and listeners see
        // one reset, not the unload inside it.
        container->loadPlugins(directory);
        const QList<QPointer<Plugin>> first = acceptedPlugins(*container);
        pluginModelLog->take();
        QSignalSpy reset(container.get(), SIGNAL(nodeContainerReset(const TreeNode *)));
        QApplication::setOverrideCursor(Qt::WaitCursor);

        container->loadPlugins(directory);

        QCOMPARE(first.count(nullptr), first.size());
        QCOMPARE(TreeString::fromTree(container->rootNode()), tree);
        QCOMPARE(TreeString::fromModel(container->treeNodeModel()), tree);
        QCOMPARE(container->availableOperationsClass(), mask);
        QCOMPARE(QStringLiteral("%1 of %2").arg(acceptedPlugins(*container).size()).arg(container->plugins().size()),
                 plugins);
        QCOMPARE(container->pluginPath(), directory);
        QCOMPARE(reset.count(), 1);
        QCOMPARE(reset.at(0).at(0).value<const TreeNode *>(), container->rootNode());
        QCOMPARE(pluginModelLog->take(), oneReset);
        // The caller's wait cursor is the caller's to restore.
        QVERIFY(QApplication::overrideCursor());

        // Requests of every module, at every depth, reach the container.
        QSignalSpy content(container.get(), SIGNAL(contentElementWidgetChanged(int)));
        QSignalSpy menu(container.get(), SIGNAL(customContextMenuRequested(QPoint)));
        QSignalSpy current(container.get(), SIGNAL(setCurrentNode(TreeNode *)));
        const QList<TreeNode *> modules = container->modules();
        for (TreeNode *module : modules) {
            Q_EMIT qobject_cast<Module *>(module)->contentElementWidgetChanged(3);
            Q_EMIT qobject_cast<Module *>(module)->customContextMenuRequested(QPoint(4, 5));
            module->emitSetCurrentNode();
        }
        const int n = modules.size();
        QCOMPARE(QList<int>({content.count(), menu.count(), current.count()}), QList<int>({n, n, n}));

        // Unloading takes every plugin and module, announced as one reset.
        const QList<QPointer<Plugin>> second = acceptedPlugins(*container);
        container->unloadPlugins();
        QCOMPARE(second.count(nullptr), second.size());
        QCOMPARE(TreeString::fromModel(container->treeNodeModel()), QString());
        QCOMPARE(container->availableOperationsClass(), quint64(0));
        QVERIFY(container->modules().isEmpty() && container->plugins().isEmpty() && container->pluginPath().isEmpty());
        QCOMPARE(reset.count(), 2);
        QCOMPARE(pluginModelLog->take(), oneReset);
    }

    void missingDirectory_data()
    {
        QTest::addColumn<QString>("path");
        QTest::newRow("does not exist") << pluginDir + "/nothing/here";
        QTest::newRow("a file") << pluginDir + "/broken.so";
        QTest::newRow("empty") << QString();
    }

    void missingDirectory()
    {
        QFETCH(QString, path);
        DialogAnswerer answerer;
        container->loadPlugins(pluginDir);
        pluginModelLog->take();
        QSignalSpy reset(container.get(), SIGNAL(nodeContainerReset(const TreeNode *)));
        QApplication::setOverrideCursor(Qt::WaitCursor);

        container->loadPlugins(path);

        const QString box = QStringLiteral("|Plugin directory '%1' not exist.|%2").arg(path).arg(QMessageBox::Ok);
        QCOMPARE(answerer.seen, QStringList(box));
        // The box is not shown under the caller's wait cursor.
        QVERIFY(!QApplication::overrideCursor());
        // What was loaded is gone, and no reset is announced for the empty tree.
        QCOMPARE(reset.count(), 0);
        QCOMPARE(container->pluginPath(), path);
        QVERIFY(container->plugins().isEmpty() && container->modules().isEmpty());

        // The plugin model's reset stays open until the next load closes it;
        // that load opens no second one inside it.
        container->loadPlugins(pluginDir);
        QCOMPARE(pluginModelLog->take(), oneReset);
        QCOMPARE(container->pluginModel()->rowCount(), 7);
    }

    void pluginModel_data()
    {
        QTest::addColumn<QString>("file");
        QTest::addColumn<QString>("name");        // empty: refused, the file name shows
        QTest::addColumn<QString>("description"); // column 1, or a part of it when refused
        QTest::addColumn<QStringList>("modules"); // "id|description" per row below

        QTest::newRow("accepted") << "valid.so" << "valid plugin" << "The plugin valid plugin"
                                  << QStringList{"alpha|alpha module", "|", "alpha-child|alpha-child module"};
        QTest::newRow("accepted, in a subdirectory")
            << "sub/nested.so" << "nested plugin" << "The plugin nested plugin" << QStringList{"delta|delta module"};
        QTest::newRow("not valid") << "invalid.so" << "" << "The plugin cannot work on this system." << QStringList();
        QTest::newRow("another interface") << "otherinterface.so" << "" << "brel-admin-kvt/0.0" << QStringList();
        QTest::newRow("not a shared object") << "broken.so" << "" << "broken.so" << QStringList();
    }

    void pluginModel()
    {
        QFETCH(QString, file);
        QFETCH(QString, name);
        QFETCH(QString, description);
        QFETCH(QStringList, modules);

        container->loadPlugins(pluginDir);
        PluginModel *model = container->pluginModel();
        const QString path = pluginDir + QLatin1Char('/') + file;
        const QModelIndex top = model->match(model->index(0, 0), Qt::ToolTipRole, path, 1, Qt::MatchExactly).value(0);
        QVERIFY(top.isValid());
        const QString about = top.sibling(top.row(), 1).data().toString();
        const bool accepted = !name.isEmpty();

        QCOMPARE(top.data().toString(), accepted ? name : path);
        // Theme icons are shared by name, whether the theme has them or not.
        const QIcon state = QIcon::fromTheme(accepted ? "task-complete" : "task-reject");
        QCOMPARE(top.data(Qt::DecorationRole).value<QIcon>().cacheKey(), state.cacheKey());
        // A refused file says why, readable by a person.
        QVERIFY2(accepted ? about == description : about.contains(description) && !about.contains("Unknown error"),
                 qPrintable(about));
        QCOMPARE(model->ObjectToIndex(model->indexToObject(top)), top);

        QStringList rows;
        for (int row = 0; row < model->rowCount(top); ++row)
            rows.append(model->index(row, 0, top).data().toString() + '|'
                        + model->index(row, 1, top).data().toString());
        QCOMPARE(rows, modules);
    }

    void dialog()
    {
        PluginDialog *dialog = dialogOf(*container);
        QVERIFY(dialog);
        QCOMPARE(dialog->windowTitle(), QStringLiteral("Plugins and modules"));
        QVERIFY(dialog->findChild<QLineEdit *>("_pathLineEdit")->isReadOnly());
        QCOMPARE(dialog->findChild<QTreeView *>("_moduleTreeView")->model(), container->treeNodeModel());

        // Loaded while the dialog is open: one reset of the plugin list, and the
        // path field follows the container when the dialog is shown again.
        container->showPluginDialog();
        QVERIFY(QTest::qWaitForWindowExposed(dialog));
        pluginModelLog->take();
        container->loadPlugins(pluginDir);
        QCOMPARE(pluginModelLog->take(), oneReset);
        dialog->findChild<QDialogButtonBox *>("_buttonBox")->button(QDialogButtonBox::Close)->click();
        QVERIFY(!dialog->isVisible());
        container->showPluginDialog();
        QCOMPARE(dialog->findChild<QLineEdit *>("_pathLineEdit")->text(), pluginDir);

        // The geometry outlives the dialog.
        dialog->resize(530, 420);
        container.reset();
        PluginContainer again;
        QCOMPARE(dialogOf(again)->size(), QSize(530, 420));
    }

    void dialogChangePath_data()
    {
        QTest::addColumn<QString>("loadedFrom");
        QTest::addColumn<QString>("answer"); // typed into the file dialog, which opens at the current path
        QTest::addColumn<QString>("expected");

        QTest::newRow("cancelled") << pluginDir << "" << pluginDir;
        QTest::newRow("the current directory, written otherwise") << pluginDir + "/" << "." << pluginDir + "/";
        QTest::newRow("another directory") << pluginDir << "sub" << pluginDir + "/sub";
    }

    void dialogChangePath()
    {
        QFETCH(QString, loadedFrom);
        QFETCH(QString, answer);
        QFETCH(QString, expected);
        container->loadPlugins(loadedFrom);
        PluginDialog *dialog = dialogOf(*container);
        // Shown and hidden again: the path field now holds the path loaded. The
        // answerer would close the dialog as it closes any other.
        container->showPluginDialog();
        dialog->hide();
        pluginModelLog->take();
        DialogAnswerer answerer;
        answerer.answerFile(answer);

        dialog->findChild<QPushButton *>("_changePushButton")->click();

        QCOMPARE(answerer.seen, QStringList("file:Plugin directory"));
        QCOMPARE(pluginModelLog->take(), expected == loadedFrom ? QStringList() : oneReset);
        QCOMPARE(container->pluginPath(), expected);
        QCOMPARE(dialog->findChild<QLineEdit *>("_pathLineEdit")->text(), expected);
    }

    void dialogOutlivesContainer()
    {
        QWidget window;
        auto *owned = new PluginContainer(&window);
        QPointer<PluginDialog> dialog = dialogOf(*owned);
        owned->loadPlugins(pluginDir);

        delete owned;

        // The window owns the dialog; it stays usable without its container.
        QVERIFY(dialog);
        dialog->show();
        QVERIFY(!dialog->findChild<QPushButton *>("_changePushButton")->isEnabled());
        dialog->changePath();
        QVERIFY(!dialog->findChild<QTreeView *>("_pluginTtreeView")->model());
    }

    void examplePlugin()
    {
#ifndef KVT_EXAMPLE_PLUGIN_DIR
        QSKIP("the examples are not built (KVT_BUILD_EXAMPLES is off)");
#else
        // Start-up as a tool does it: plugins first, then the element tree.
        ElementContainer elements;
        QAbstractItemModelTester tester(elements.treeNodeModel(),
                                        QAbstractItemModelTester::FailureReportingMode::QtTest);
        container->loadPlugins(QStringLiteral(KVT_EXAMPLE_PLUGIN_DIR));
        elements.pluginContainerReset(container->rootNode());

        QCOMPARE(container->pluginModel()->index(0, 0).data().toString(), QStringLiteral("Hello"));
        QCOMPARE(TreeString::fromTree(elements.rootNode()), QStringLiteral("greeting_evening greeting_morning"));
        // Unloading takes the elements with their modules.
        container->unloadPlugins();
        QCOMPARE(TreeString::fromTree(elements.rootNode()), QString());
#endif
    }
};

QTEST_MAIN(PluginContainerTest)
#include "tst_plugincontainer.moc"
