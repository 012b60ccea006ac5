#include <kvt-common/elementcontainer.h>
#include <kvt-common/module.h>
#include <kvt-common/plugin.h>
#include <kvt-common/plugincontainer.h>
#include <kvt-common/plugindialog.h>
#include <kvt-common/pluginmodel.h>
#include <kvt-common/treenodemodel.h>

#include "signallog.h"
#include "treestring.h"

#include <QAbstractItemModelTester>
#include <QApplication>
#include <QDialogButtonBox>
#include <QFileDialog>
#include <QLineEdit>
#include <QMessageBox>
#include <QPluginLoader>
#include <QPointer>
#include <QPushButton>
#include <QSettings>
#include <QSignalSpy>
#include <QTabWidget>
#include <QTemporaryDir>
#include <QTreeView>
#include <QtTest>

#include <memory>

Q_DECLARE_METATYPE(const TreeNode *)

namespace {

const QString pluginDir = QStringLiteral(KVT_TEST_PLUGIN_DIR);
const QString allModules = QStringLiteral("alpha[alpha-child] beta delta");

QString pluginFile(const QString &relative)
{
    return pluginDir + QLatin1Char('/') + relative;
}

// Answers every message box and file dialog that comes up, so no test waits
// on a dialog: boxes are described and confirmed, file dialogs get the
// answer a test sets (cancelled without one). No QCOMPARE in here: a failed
// check would leave the dialog open.
class DialogAnswerer : public QObject
{
public:
    DialogAnswerer()
    {
        connect(&timer, &QTimer::timeout, this, &DialogAnswerer::answer);
        timer.start(20);
    }

    QStringList boxes;       // "critical ok|title|text"
    QStringList fileDialogs; // "title|start directory|directories only"
    QString fileAnswer;

private:
    void answer()
    {
        QWidget *modal = QApplication::activeModalWidget();
        if (auto *box = qobject_cast<QMessageBox *>(modal)) {
            boxes.append(QStringLiteral("%1 %2|%3|%4").arg(
                box->icon() == QMessageBox::Critical ? "critical" : "other",
                box->standardButtons() == QMessageBox::Ok ? "ok" : "buttons",
                box->windowTitle(), box->text()));
            box->done(QMessageBox::Ok);
        } else if (auto *dialog = qobject_cast<QFileDialog *>(modal)) {
            // One that did not take its answer is cancelled, not asked again.
            if (dialog == answered || fileAnswer.isEmpty()) {
                dialog->reject();
                return;
            }
            answered = dialog;
            fileDialogs.append(QStringLiteral("%1|%2|%3").arg(
                dialog->windowTitle(), dialog->directory().absolutePath(),
                dialog->testOption(QFileDialog::ShowDirsOnly) ? "directories only" : "files too"));
            // Nothing typed or selected: the dialog answers with the
            // directory it shows, whatever its list holds by now.
            dialog->setDirectory(fileAnswer);
            dialog->findChild<QLineEdit *>(QStringLiteral("fileNameEdit"))->clear();
            for (QAbstractItemView *view : dialog->findChildren<QAbstractItemView *>())
                view->selectionModel()->clear();
            static_cast<QDialog *>(dialog)->accept();
        }
    }

    QTimer timer;
    QPointer<QFileDialog> answered;
};

int acceptedCount(const PluginContainer &container)
{
    int count = 0;
    for (const PluginContainer::PluginEntry &entry : container.plugins())
        count += entry.second ? 1 : 0;
    return count;
}

QPointer<Plugin> someAcceptedPlugin(const PluginContainer &container)
{
    for (const PluginContainer::PluginEntry &entry : container.plugins()) {
        if (entry.second)
            return entry.second;
    }
    return nullptr;
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

template <class T>
T *child(QWidget *dialog, const char *name)
{
    return dialog->findChild<T *>(QLatin1String(name));
}

} // namespace

class PluginContainerTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanup();

    void loadDirectory_data();
    void loadDirectory();
    void reloadAndUnload();
    void moduleSignals();
    void missingDirectory_data();
    void missingDirectory();
    void pluginModel_data();
    void pluginModel();
    void dialog();
    void dialogChangePath_data();
    void dialogChangePath();
    void dialogOutlivesContainer();
    void examplePlugin();

private:
    std::unique_ptr<DialogAnswerer> answerer;
    std::unique_ptr<PluginContainer> container;
    std::unique_ptr<QAbstractItemModelTester> pluginModelTester, moduleModelTester;
    SignalLog *pluginModelLog = nullptr;
    QTemporaryDir scratch;
};

void PluginContainerTest::initTestCase()
{
    qRegisterMetaType<const TreeNode *>();
    qRegisterMetaType<TreeNode *>();
    QVERIFY(QFileInfo(pluginFile(QStringLiteral("sub/nested.so"))).isFile());
}

void PluginContainerTest::init()
{
    answerer.reset(new DialogAnswerer);
    container.reset(new PluginContainer);
    const auto mode = QAbstractItemModelTester::FailureReportingMode::QtTest;
    pluginModelTester.reset(new QAbstractItemModelTester(container->pluginModel(), mode));
    moduleModelTester.reset(new QAbstractItemModelTester(container->treeNodeModel(), mode));
    pluginModelLog = new SignalLog(container.get());
    pluginModelLog->watchModel(container->pluginModel());
}

void PluginContainerTest::cleanup()
{
    pluginModelTester.reset();
    moduleModelTester.reset();
    container.reset();
    while (QApplication::overrideCursor())
        QApplication::restoreOverrideCursor();
    // A box nobody expected fails the test that raised it.
    QCOMPARE(answerer->boxes, QStringList());
    answerer.reset();
    QSettings().clear();
}

void PluginContainerTest::loadDirectory_data()
{
    QTest::addColumn<QStringList>("files"); // "from=to", copied into a directory; none: all
    QTest::addColumn<QString>("tree");
    QTest::addColumn<quint64>("mask");
    QTest::addColumn<int>("tried");
    QTest::addColumn<int>("accepted");

    QTest::newRow("every kind of file") << QStringList() << allModules << quint64(7) << 7 << 4;
    QTest::newRow("masks 1 and 4") << QStringList{"valid.so", "masked.so"}
                                   << "alpha[alpha-child] beta" << quint64(5) << 2 << 2;
    QTest::newRow("modules() without a module") << QStringList{"nomodules.so"} << "" << quint64(0) << 1 << 1;
    QTest::newRow("not valid on this host") << QStringList{"invalid.so"} << "" << quint64(0) << 1 << 0;
    QTest::newRow("another interface") << QStringList{"otherinterface.so"} << "" << quint64(0) << 1 << 0;
    QTest::newRow("not a shared object") << QStringList{"broken.so"} << "" << quint64(0) << 1 << 0;
    QTest::newRow("deep in subdirectories") << QStringList{"sub/nested.so=a/b/c/nested.so"}
                                            << "delta" << quint64(2) << 1 << 1;
    QTest::newRow("no plugin files") << QStringList{"broken.so=readme.txt", "broken.so=lib.so.1"}
                                     << "" << quint64(0) << 0 << 0;
}

void PluginContainerTest::loadDirectory()
{
    QFETCH(QStringList, files);
    QFETCH(QString, tree);
    QFETCH(quint64, mask);
    QFETCH(int, tried);
    QFETCH(int, accepted);

    QTemporaryDir own;
    const QString directory = files.isEmpty() ? pluginDir : own.path();
    for (const QString &file : files) {
        const QString to = own.filePath(file.section(QLatin1Char('='), -1));
        QVERIFY(QDir().mkpath(QFileInfo(to).path()));
        QVERIFY(QFile::copy(pluginFile(file.section(QLatin1Char('='), 0, 0)), to));
    }
    QSignalSpy aboutToReset(container.get(), SIGNAL(nodeContainerAboutToBeReset()));
    QSignalSpy reset(container.get(), SIGNAL(nodeContainerReset(const TreeNode *)));
    QApplication::setOverrideCursor(Qt::WaitCursor);

    container->loadPlugins(directory);

    QCOMPARE(TreeString::fromTree(container->rootNode()), tree);
    QCOMPARE(TreeString::fromModel(container->treeNodeModel()), tree);
    QCOMPARE(container->availableOperationsClass(), mask);
    QCOMPARE(container->plugins().size(), tried);
    QCOMPARE(acceptedCount(*container), accepted);
    QCOMPARE(container->pluginPath(), directory);
    QCOMPARE(container->modules().size(), tree.split(QRegularExpression("[\\[\\] ]+"), Qt::SkipEmptyParts).size());
    QCOMPARE(aboutToReset.count(), 1);
    QCOMPARE(reset.count(), 1);
    QCOMPARE(reset.at(0).at(0).value<const TreeNode *>(), container->rootNode());
    QCOMPARE(pluginModelLog->take(), QStringList({"aboutToReset", "reset"}));
    // The caller's wait cursor is the caller's to restore.
    QVERIFY(QApplication::overrideCursor());
}

void PluginContainerTest::reloadAndUnload()
{
    container->loadPlugins(pluginDir);
    QPointer<Plugin> first = someAcceptedPlugin(*container);
    QPointer<TreeNode> firstModule = container->modules().constFirst();
    pluginModelLog->take();
    QSignalSpy aboutToReset(container.get(), SIGNAL(nodeContainerAboutToBeReset()));
    QSignalSpy reset(container.get(), SIGNAL(nodeContainerReset(const TreeNode *)));

    container->loadPlugins(pluginDir);

    // One set of modules, and one reset: the unload inside is not announced.
    QVERIFY(!first && !firstModule);
    QCOMPARE(TreeString::fromTree(container->rootNode()), allModules);
    QCOMPARE(container->modules().size(), 4);
    QCOMPARE(container->plugins().size(), 7);
    QCOMPARE(aboutToReset.count(), 1);
    QCOMPARE(reset.count(), 1);
    QCOMPARE(pluginModelLog->take(), QStringList({"aboutToReset", "reset"}));

    // Unticked in the module tree; the module saves that when it goes.
    TreeNodeModel *model = container->treeNodeModel();
    QCOMPARE(model->index(0, 0).data().toString(), QStringLiteral("alpha"));
    QVERIFY(model->setData(model->index(0, 1), Qt::Unchecked, Qt::CheckStateRole));
    first = someAcceptedPlugin(*container);

    container->unloadPlugins();

    QVERIFY(!first);
    QCOMPARE(QSettings().value(QStringLiteral("module/alphaparanoid")), QVariant(false));
    QCOMPARE(container->availableOperationsClass(), quint64(0));
    QCOMPARE(container->pluginPath(), QString());
    QVERIFY(container->modules().isEmpty() && container->plugins().isEmpty());
    QCOMPARE(model->rowCount(), 0);
    QCOMPARE(aboutToReset.count(), 2);
    QCOMPARE(reset.count(), 2);
    QCOMPARE(pluginModelLog->take(), QStringList({"aboutToReset", "reset"}));
}

void PluginContainerTest::moduleSignals()
{
    container->loadPlugins(pluginDir);
    QSignalSpy content(container.get(), SIGNAL(contentElementWidgetChanged(int)));
    QSignalSpy menu(container.get(), SIGNAL(customContextMenuRequested(QPoint)));
    QSignalSpy current(container.get(), SIGNAL(setCurrentNode(TreeNode *)));
    // Modules of every plugin and at every depth are heard.
    for (TreeNode *node : container->modules()) {
        auto *module = qobject_cast<Module *>(node);
        Q_EMIT module->contentElementWidgetChanged(3);
        Q_EMIT module->customContextMenuRequested(QPoint(4, 5));
        module->emitSetCurrentNode();
    }
    QCOMPARE(content.count(), 4);
    QCOMPARE(content.at(0).at(0).toInt(), 3);
    QCOMPARE(menu.count(), 4);
    QCOMPARE(menu.at(0).at(0).toPoint(), QPoint(4, 5));
    QCOMPARE(current.count(), 4);
}

void PluginContainerTest::missingDirectory_data()
{
    QTest::addColumn<QString>("path");
    QTest::newRow("does not exist") << scratch.filePath(QStringLiteral("nothing/here"));
    QTest::newRow("a file") << pluginFile(QStringLiteral("broken.so"));
    QTest::newRow("empty") << QString();
}

void PluginContainerTest::missingDirectory()
{
    QFETCH(QString, path);
    container->loadPlugins(pluginDir);
    pluginModelLog->take();
    QSignalSpy reset(container.get(), SIGNAL(nodeContainerReset(const TreeNode *)));
    QApplication::setOverrideCursor(Qt::WaitCursor);

    container->loadPlugins(path);

    QCOMPARE(answerer->boxes, QStringList({QStringLiteral("critical ok||Plugin directory '%1' not exist.").arg(path)}));
    answerer->boxes.clear();
    QVERIFY(!QApplication::overrideCursor());
    // What was loaded is gone, and no reset is announced for the empty tree.
    QCOMPARE(reset.count(), 0);
    QCOMPARE(container->pluginPath(), path);
    QVERIFY(container->plugins().isEmpty() && container->modules().isEmpty());
    QCOMPARE(container->treeNodeModel()->rowCount(), 0);

    // The plugin model's reset stays open until the next load closes it;
    // that load opens no second one inside it.
    container->loadPlugins(pluginDir);
    QCOMPARE(pluginModelLog->take(), QStringList({"aboutToReset", "reset"}));
    QCOMPARE(container->pluginModel()->rowCount(), 7);
}

void PluginContainerTest::pluginModel_data()
{
    QTest::addColumn<QString>("file");
    QTest::addColumn<QString>("name");        // empty: refused, the file name shows
    QTest::addColumn<QString>("description"); // column 1, or a part of it when refused
    QTest::addColumn<QStringList>("modules"); // "id|description" per row below

    QTest::newRow("accepted") << "valid.so" << "valid plugin" << "The plugin valid plugin"
                              << QStringList{"alpha|alpha module", "|", "alpha-child|alpha-child module"};
    QTest::newRow("accepted, in a subdirectory") << "sub/nested.so" << "nested plugin"
                                                 << "The plugin nested plugin" << QStringList{"delta|delta module"};
    QTest::newRow("accepted, no module") << "nomodules.so" << "nomodules plugin"
                                         << "The plugin nomodules plugin" << QStringList{"|"};
    QTest::newRow("not valid") << "invalid.so" << "" << "The plugin cannot work on this system." << QStringList();
    QTest::newRow("another interface") << "otherinterface.so" << "" << "brel-admin-kvt/0.0" << QStringList();
    QTest::newRow("not a shared object") << "broken.so" << "" << "broken.so" << QStringList();
}

void PluginContainerTest::pluginModel()
{
    QFETCH(QString, file);
    QFETCH(QString, name);
    QFETCH(QString, description);
    QFETCH(QStringList, modules);

    container->loadPlugins(pluginDir);
    PluginModel *model = container->pluginModel();
    const QModelIndexList found = model->match(model->index(0, 0), Qt::ToolTipRole, pluginFile(file), 1, Qt::MatchExactly);
    QCOMPARE(found.size(), 1);
    const QModelIndex top = found.first();
    const QModelIndex about = top.sibling(top.row(), 1);
    const bool accepted = !name.isEmpty();

    QCOMPARE(top.data().toString(), accepted ? name : pluginFile(file));
    // Theme icons are shared by name, whether the theme has them or not.
    const QIcon state = QIcon::fromTheme(accepted ? QStringLiteral("task-complete") : QStringLiteral("task-reject"));
    QCOMPARE(top.data(Qt::DecorationRole).value<QIcon>().cacheKey(), state.cacheKey());
    if (accepted) {
        QCOMPARE(about.data().toString(), description);
        QVERIFY(qobject_cast<Plugin *>(model->indexToObject(top)));
    } else {
        // Why the file was refused, readable by a person.
        QVERIFY2(about.data().toString().contains(description), qPrintable(about.data().toString()));
        QVERIFY(!about.data().toString().contains(QStringLiteral("Unknown error")));
        QVERIFY(qobject_cast<QPluginLoader *>(model->indexToObject(top)));
    }
    QCOMPARE(about.data(Qt::ToolTipRole), about.data());
    QCOMPARE(model->ObjectToIndex(model->indexToObject(top)), top);

    QStringList rows;
    for (int row = 0; row < model->rowCount(top); ++row) {
        const QModelIndex module = model->index(row, 0, top);
        QCOMPARE(module.parent(), top);
        QCOMPARE(module.data(Qt::ToolTipRole), module.data());
        rows.append(module.data().toString() + QLatin1Char('|') + module.sibling(row, 1).data().toString());
    }
    QCOMPARE(rows, modules);
}

void PluginContainerTest::dialog()
{
    PluginDialog *dialog = dialogOf(*container);
    QVERIFY(dialog);
    // The form, by the names plugins and style sheets know it by.
    const QStringList form{"gridLayout_3:QGridLayout", "_pathLabelLabel:QLabel", "_pathLineEdit:QLineEdit",
                           "_changePushButton:QPushButton", "_pluginTabWidget:QTabWidget", "_pliginTab:QWidget",
                           "gridLayout:QGridLayout", "_pluginTtreeView:QTreeView", "_moduleTab:QWidget",
                           "gridLayout_2:QGridLayout", "_moduleTreeView:QTreeView", "_buttonBox:QDialogButtonBox"};
    for (const QString &entry : form) {
        QObject *object = dialog->findChild<QObject *>(entry.section(QLatin1Char(':'), 0, 0));
        QVERIFY2(object, qPrintable(entry));
        QCOMPARE(QString::fromLatin1(object->metaObject()->className()), entry.section(QLatin1Char(':'), 1));
    }
    QCOMPARE(dialog->windowTitle(), QStringLiteral("Plugins and modules"));
    QCOMPARE(dialog->windowModality(), Qt::WindowModal);
    QCOMPARE(dialog->size(), QSize(400, 300));
    auto *tabs = child<QTabWidget>(dialog, "_pluginTabWidget");
    QCOMPARE(tabs->currentIndex(), 0);
    QCOMPARE(tabs->tabText(0) + "," + tabs->tabText(1), QStringLiteral("Plugins,Modules"));
    QVERIFY(child<QLineEdit>(dialog, "_pathLineEdit")->isReadOnly());
    QCOMPARE(child<QTreeView>(dialog, "_moduleTreeView")->model(), container->treeNodeModel());

    // Loaded while the dialog is open: one reset of the plugin list, and the
    // path field follows the container when the dialog is shown again.
    container->showPluginDialog();
    QVERIFY(QTest::qWaitForWindowExposed(dialog));
    pluginModelLog->take();
    container->loadPlugins(pluginDir);
    QCOMPARE(pluginModelLog->take(), QStringList({"aboutToReset", "reset"}));
    child<QDialogButtonBox>(dialog, "_buttonBox")->button(QDialogButtonBox::Close)->click();
    QVERIFY(!dialog->isVisible());
    container->showPluginDialog();
    QCOMPARE(child<QLineEdit>(dialog, "_pathLineEdit")->text(), pluginDir);
    QCOMPARE(child<QLineEdit>(dialog, "_pathLineEdit")->toolTip(), pluginDir);

    // The geometry outlives the dialog.
    dialog->resize(530, 420);
    container.reset();
    PluginContainer again;
    QCOMPARE(dialogOf(again)->size(), QSize(530, 420));
}

void PluginContainerTest::dialogChangePath_data()
{
    QTest::addColumn<QString>("loadedFrom");
    QTest::addColumn<QString>("answer"); // "": cancelled
    QTest::addColumn<bool>("reloads");

    QTest::newRow("cancelled") << pluginDir << "" << false;
    QTest::newRow("the current directory") << pluginDir << pluginDir << false;
    QTest::newRow("the current directory, written otherwise") << pluginDir + "/" << pluginDir << false;
    QTest::newRow("another directory") << pluginDir << pluginDir + "/sub" << true;
}

void PluginContainerTest::dialogChangePath()
{
    QFETCH(QString, loadedFrom);
    QFETCH(QString, answer);
    QFETCH(bool, reloads);

    container->loadPlugins(loadedFrom);
    QPointer<Plugin> loaded = someAcceptedPlugin(*container);
    PluginDialog *dialog = dialogOf(*container);
    container->showPluginDialog();
    pluginModelLog->take();
    answerer->fileAnswer = answer;

    child<QPushButton>(dialog, "_changePushButton")->click();

    if (!answer.isEmpty())
        QCOMPARE(answerer->fileDialogs, QStringList({"Plugin directory|" + pluginDir + "|directories only"}));
    QCOMPARE(bool(loaded), !reloads);
    QCOMPARE(pluginModelLog->take(), reloads ? QStringList({"aboutToReset", "reset"}) : QStringList());
    const QString expected = reloads ? answer : loadedFrom;
    QCOMPARE(container->pluginPath(), expected);
    QCOMPARE(child<QLineEdit>(dialog, "_pathLineEdit")->text(), expected);
    QCOMPARE(child<QLineEdit>(dialog, "_pathLineEdit")->toolTip(), expected);
}

void PluginContainerTest::dialogOutlivesContainer()
{
    QWidget window;
    auto *owned = new PluginContainer(&window);
    QPointer<PluginDialog> dialog = dialogOf(*owned);
    QCOMPARE(dialog->parentWidget(), &window);
    owned->loadPlugins(pluginDir);

    delete owned;

    // The window owns the dialog; it stays usable without its container.
    QVERIFY(dialog);
    dialog->show();
    QCOMPARE(child<QLineEdit>(dialog, "_pathLineEdit")->text(), QString());
    QVERIFY(!child<QPushButton>(dialog, "_changePushButton")->isEnabled());
    answerer->fileAnswer = pluginDir;
    dialog->changePath();
    QVERIFY(answerer->fileDialogs.isEmpty());
    QVERIFY(!child<QTreeView>(dialog, "_pluginTtreeView")->model());
}

void PluginContainerTest::examplePlugin()
{
#ifndef KVT_EXAMPLE_PLUGIN_DIR
    QSKIP("the examples are not built (KVT_BUILD_EXAMPLES is off)");
#else
    // Start-up as a tool does it: plugins first, then the element tree.
    ElementContainer elements;
    QAbstractItemModelTester tester(elements.treeNodeModel(), QAbstractItemModelTester::FailureReportingMode::QtTest);
    container->loadPlugins(QStringLiteral(KVT_EXAMPLE_PLUGIN_DIR));
    elements.pluginContainerReset(container->rootNode());

    QCOMPARE(container->pluginModel()->index(0, 0).data().toString(), QStringLiteral("Hello"));
    QCOMPARE(TreeString::fromTree(container->rootNode()), QStringLiteral("hello"));
    QCOMPARE(TreeString::fromTree(elements.rootNode()), QStringLiteral("greeting_evening greeting_morning"));
    QCOMPARE(elements.treeNodeModel()->index(1, 0).data(Qt::ToolTipRole).toString(), QStringLiteral("Good morning!"));

    // Unloading takes the elements with their modules.
    container->unloadPlugins();
    QCOMPARE(TreeString::fromTree(elements.rootNode()), QString());
#endif
}

QTEST_MAIN(PluginContainerTest)
#include "tst_plugincontainer.moc"
