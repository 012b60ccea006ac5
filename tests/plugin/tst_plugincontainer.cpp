#include <kvt-common/elementcontainer.h>
#include <kvt-common/module.h>
#include <kvt-common/moduleroottreenode.h>
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
#include <QGridLayout>
#include <QLabel>
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

#include <functional>
#include <memory>

Q_DECLARE_METATYPE(const TreeNode *)

namespace {

const QString pluginDir = QStringLiteral(KVT_TEST_PLUGIN_DIR);

QString pluginFile(const QString &relative)
{
    return pluginDir + QLatin1Char('/') + relative;
}

// Answers every message box and file dialog that comes up, so no test
// waits on a dialog: message boxes are described and confirmed, file
// dialogs get the answer a test sets (cancelled without one). Other
// windows, the plugin dialog among them, are left alone.
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
    QString fileAnswer;      // empty: cancel

private:
    void answer()
    {
        QWidget *modal = QApplication::activeModalWidget();
        if (auto *box = qobject_cast<QMessageBox *>(modal)) {
            const bool critical = box->icon() == QMessageBox::Critical;
            const bool okOnly = box->standardButtons() == QMessageBox::Ok;
            boxes.append(QStringLiteral("%1%2%3|%4").arg(
                critical ? QStringLiteral("critical") : QStringLiteral("other"),
                okOnly ? QStringLiteral(" ok|") : QStringLiteral(" buttons|"),
                box->windowTitle(), box->text()));
            box->done(QMessageBox::Ok);
        } else if (auto *dialog = qobject_cast<QFileDialog *>(modal)) {
            // A dialog that did not take its answer is cancelled, not asked
            // again and again.
            if (dialog == answered) {
                dialog->reject();
                return;
            }
            answered = dialog;
            // No QCOMPARE here: a failed check would leave the dialog open.
            fileDialogs.append(QStringLiteral("%1|%2|%3").arg(
                dialog->windowTitle(), dialog->directory().absolutePath(),
                dialog->testOption(QFileDialog::ShowDirsOnly) ? QStringLiteral("directories only")
                                                              : QStringLiteral("files too")));
            if (fileAnswer.isEmpty()) {
                dialog->reject();
            } else {
                // Nothing typed and nothing selected: the dialog answers
                // with the directory it shows, whatever its file list,
                // filled in the background, holds by now.
                dialog->setDirectory(fileAnswer);
                if (auto *edit = dialog->findChild<QLineEdit *>(QStringLiteral("fileNameEdit")))
                    edit->clear();
                for (QAbstractItemView *view : dialog->findChildren<QAbstractItemView *>()) {
                    if (view->selectionModel())
                        view->selectionModel()->clear();
                }
                static_cast<QDialog *>(dialog)->accept();
            }
        }
    }

    QTimer timer;
    QPointer<QFileDialog> answered;
};

QStringList sorted(QStringList list)
{
    list.sort();
    return list;
}

QStringList ids(const QList<TreeNode *> &nodes)
{
    QStringList result;
    for (const TreeNode *node : nodes)
        result.append(node->id());
    return result;
}

int acceptedCount(const PluginContainer &container)
{
    int count = 0;
    for (const PluginContainer::PluginEntry &entry : container.plugins())
        count += entry.second ? 1 : 0;
    return count;
}

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

private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanup();

    void loadDirectory_data();
    void loadDirectory();
    void loadTwice();
    void moduleSignals_data();
    void moduleSignals();
    void unload();
    void missingDirectory_data();
    void missingDirectory();
    void pluginModel_data();
    void pluginModel();
    void dialogForm_data();
    void dialogForm();
    void dialogFollowsContainer();
    void dialogChangePath_data();
    void dialogChangePath();
    void dialogGeometry();
    void dialogOutlivesContainer();
    void elementsOfPlugins();
    void examplePlugin();

private:
    void watch(PluginContainer *container);

    std::unique_ptr<DialogAnswerer> answerer;
    std::unique_ptr<PluginContainer> container;
    std::vector<std::unique_ptr<QAbstractItemModelTester>> testers;
    SignalLog *pluginModelLog = nullptr;
    QTemporaryDir scratch;
};

void PluginContainerTest::initTestCase()
{
    qRegisterMetaType<const TreeNode *>();
    qRegisterMetaType<TreeNode *>();
    QVERIFY(QFileInfo(pluginFile(QStringLiteral("valid.so"))).isFile());
    QVERIFY(QFileInfo(pluginFile(QStringLiteral("sub/nested.so"))).isFile());
    QVERIFY(scratch.isValid());

    // A theme with the two state icons, so that they are told apart by name.
    const QString base = scratch.filePath(QStringLiteral("icons/kvt-test"));
    QVERIFY(QDir().mkpath(base + QStringLiteral("/16x16/actions")));
    QFile index(base + QStringLiteral("/index.theme"));
    QVERIFY(index.open(QIODevice::WriteOnly));
    index.write("[Icon Theme]\nName=kvt-test\nDirectories=16x16/actions\n\n"
                "[16x16/actions]\nSize=16\nType=Fixed\n");
    index.close();
    for (const char *name : {"task-complete", "task-reject"}) {
        QPixmap pixmap(16, 16);
        pixmap.fill(Qt::green);
        QVERIFY(pixmap.save(base + QStringLiteral("/16x16/actions/%1.png").arg(QLatin1String(name))));
    }
    QIcon::setThemeSearchPaths({scratch.filePath(QStringLiteral("icons"))});
    QIcon::setThemeName(QStringLiteral("kvt-test"));
}

void PluginContainerTest::watch(PluginContainer *watched)
{
    testers.emplace_back(new QAbstractItemModelTester(
        watched->pluginModel(), QAbstractItemModelTester::FailureReportingMode::QtTest));
    testers.emplace_back(new QAbstractItemModelTester(
        watched->treeNodeModel(), QAbstractItemModelTester::FailureReportingMode::QtTest));
}

void PluginContainerTest::init()
{
    answerer.reset(new DialogAnswerer);
    container.reset(new PluginContainer);
    watch(container.get());
    pluginModelLog = new SignalLog(container.get());
    pluginModelLog->watchModel(container->pluginModel());
}

void PluginContainerTest::cleanup()
{
    testers.clear();
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
    QTest::addColumn<QStringList>("files"); // copied into a directory of their own; none: all
    QTest::addColumn<QString>("tree");
    QTest::addColumn<quint64>("mask");
    QTest::addColumn<int>("tried");
    QTest::addColumn<int>("accepted");

    QTest::newRow("every kind of file") << QStringList() << "alpha[alpha-child] beta delta"
                                        << quint64(7) << 7 << 4;
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

    QString directory = pluginDir;
    QTemporaryDir own;
    if (!files.isEmpty()) {
        directory = own.path();
        for (const QString &file : files) {
            const QString from = file.section(QLatin1Char('='), 0, 0);
            const QString to = own.filePath(file.section(QLatin1Char('='), -1));
            QVERIFY(QDir().mkpath(QFileInfo(to).path()));
            QVERIFY(QFile::copy(pluginFile(from), to));
        }
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
    // Modules that hang anywhere in the tree, and only those.
    QCOMPARE(sorted(ids(container->modules())),
             sorted(tree.split(QRegularExpression(QStringLiteral("[\\[\\] ]+")), Qt::SkipEmptyParts)));
    QCOMPARE(aboutToReset.count(), 1);
    QCOMPARE(reset.count(), 1);
    QCOMPARE(reset.at(0).at(0).value<const TreeNode *>(), container->rootNode());
    QCOMPARE(pluginModelLog->take(), QStringList({"aboutToReset", "reset"}));
    QCOMPARE(container->pluginModel()->rowCount(), tried);
    // The caller's wait cursor is the caller's to restore.
    QVERIFY(QApplication::overrideCursor());
}

void PluginContainerTest::loadTwice()
{
    container->loadPlugins(pluginDir);
    QPointer<Plugin> firstPlugin = container->plugins().constFirst().second;
    for (const PluginContainer::PluginEntry &entry : container->plugins()) {
        if (entry.second)
            firstPlugin = entry.second;
    }
    QPointer<TreeNode> firstModule = container->modules().constFirst();
    QVERIFY(firstPlugin && firstModule);
    pluginModelLog->take();
    QSignalSpy aboutToReset(container.get(), SIGNAL(nodeContainerAboutToBeReset()));
    QSignalSpy reset(container.get(), SIGNAL(nodeContainerReset(const TreeNode *)));

    container->loadPlugins(pluginDir);

    // The first set is gone, not kept beside the second.
    QVERIFY(!firstPlugin);
    QVERIFY(!firstModule);
    QCOMPARE(TreeString::fromTree(container->rootNode()), QStringLiteral("alpha[alpha-child] beta delta"));
    QCOMPARE(container->modules().size(), 4);
    QCOMPARE(container->plugins().size(), 7);
    QCOMPARE(container->availableOperationsClass(), quint64(7));
    // The unload inside the reload is not announced on its own.
    QCOMPARE(aboutToReset.count(), 1);
    QCOMPARE(reset.count(), 1);
    QCOMPARE(pluginModelLog->take(), QStringList({"aboutToReset", "reset"}));
}

void PluginContainerTest::moduleSignals_data()
{
    QTest::addColumn<QString>("module");
    QTest::addColumn<QString>("signal");

    QTest::newRow("content, top module") << "alpha" << "content";
    QTest::newRow("content, module below a module") << "alpha-child" << "content";
    QTest::newRow("context menu, plugin in a subdirectory") << "delta" << "menu";
    QTest::newRow("current node, module below a module") << "alpha-child" << "current";
}

void PluginContainerTest::moduleSignals()
{
    QFETCH(QString, module);
    QFETCH(QString, signal);

    container->loadPlugins(pluginDir);
    Module *source = nullptr;
    for (TreeNode *node : container->modules()) {
        if (node->id() == module)
            source = qobject_cast<Module *>(node);
    }
    QVERIFY(source);
    QSignalSpy content(container.get(), SIGNAL(contentElementWidgetChanged(int)));
    QSignalSpy menu(container.get(), SIGNAL(customContextMenuRequested(QPoint)));
    QSignalSpy current(container.get(), SIGNAL(setCurrentNode(TreeNode *)));

    if (signal == QLatin1String("content"))
        Q_EMIT source->contentElementWidgetChanged(3);
    else if (signal == QLatin1String("menu"))
        Q_EMIT source->customContextMenuRequested(QPoint(4, 5));
    else
        source->emitSetCurrentNode();

    QCOMPARE(content.count(), signal == QLatin1String("content") ? 1 : 0);
    QCOMPARE(menu.count(), signal == QLatin1String("menu") ? 1 : 0);
    QCOMPARE(current.count(), signal == QLatin1String("current") ? 1 : 0);
    if (!content.isEmpty())
        QCOMPARE(content.at(0).at(0).toInt(), 3);
    if (!menu.isEmpty())
        QCOMPARE(menu.at(0).at(0).toPoint(), QPoint(4, 5));
    if (!current.isEmpty())
        QCOMPARE(current.at(0).at(0).value<TreeNode *>(), source);
}

void PluginContainerTest::unload()
{
    container->loadPlugins(pluginDir);
    QList<QPointer<TreeNode>> modules;
    for (TreeNode *node : container->modules())
        modules.append(node);
    // Unticked through the module tree: the module saves that as it goes.
    TreeNodeModel *model = container->treeNodeModel();
    const QModelIndex alpha = model->index(0, 1);
    QCOMPARE(model->index(0, 0).data().toString(), QStringLiteral("alpha"));
    QVERIFY(model->setData(alpha, Qt::Unchecked, Qt::CheckStateRole));
    pluginModelLog->take();
    QSignalSpy aboutToReset(container.get(), SIGNAL(nodeContainerAboutToBeReset()));
    QSignalSpy reset(container.get(), SIGNAL(nodeContainerReset(const TreeNode *)));

    container->unloadPlugins();

    for (const QPointer<TreeNode> &module : qAsConst(modules))
        QVERIFY(!module);
    QCOMPARE(QSettings().value(QStringLiteral("module/alphaparanoid")), QVariant(false));
    QCOMPARE(container->availableOperationsClass(), quint64(0));
    QCOMPARE(container->pluginPath(), QString());
    QVERIFY(container->modules().isEmpty());
    QVERIFY(container->plugins().isEmpty());
    QCOMPARE(container->rootNode()->childNodesCount(), 0);
    QCOMPARE(model->rowCount(), 0);
    QCOMPARE(container->pluginModel()->rowCount(), 0);
    QCOMPARE(aboutToReset.count(), 1);
    QCOMPARE(reset.count(), 1);
    QCOMPARE(pluginModelLog->take(), QStringList({"aboutToReset", "reset"}));

    // Unloading what is already empty changes nothing and harms nothing.
    container->unloadPlugins();
    QCOMPARE(container->plugins().size(), 0);
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
    QSignalSpy aboutToReset(container.get(), SIGNAL(nodeContainerAboutToBeReset()));
    QSignalSpy reset(container.get(), SIGNAL(nodeContainerReset(const TreeNode *)));
    QApplication::setOverrideCursor(Qt::WaitCursor);

    container->loadPlugins(path);

    QCOMPARE(answerer->boxes, QStringList({QStringLiteral("critical ok||Plugin directory '%1' not exist.").arg(path)}));
    answerer->boxes.clear();
    QVERIFY(!QApplication::overrideCursor());
    // What was loaded is gone; no reset is announced for the empty tree.
    QCOMPARE(aboutToReset.count(), 1);
    QCOMPARE(reset.count(), 0);
    QCOMPARE(container->pluginPath(), path);
    QVERIFY(container->plugins().isEmpty());
    QVERIFY(container->modules().isEmpty());
    QCOMPARE(container->availableOperationsClass(), quint64(0));
    QCOMPARE(container->rootNode()->childNodesCount(), 0);
    QCOMPARE(container->treeNodeModel()->rowCount(), 0);

    // The plugin model's reset stays open until the next load closes it,
    // and the next load opens no second one inside it.
    container->loadPlugins(pluginDir);
    QCOMPARE(pluginModelLog->take(), QStringList({"aboutToReset", "reset"}));
    QCOMPARE(container->pluginModel()->rowCount(), 7);
}

void PluginContainerTest::pluginModel_data()
{
    QTest::addColumn<QString>("file");
    QTest::addColumn<QString>("name");        // empty: the file name is shown
    QTest::addColumn<QString>("description"); // what column 1 holds, or a part of it
    QTest::addColumn<QStringList>("modules"); // "id|description" per row below

    QTest::newRow("accepted") << "valid.so" << "valid plugin" << "The plugin valid plugin"
                              << QStringList{"alpha|alpha module", "|", "alpha-child|alpha-child module"};
    QTest::newRow("accepted, in a subdirectory") << "sub/nested.so" << "nested plugin"
                                                 << "The plugin nested plugin" << QStringList{"delta|delta module"};
    QTest::newRow("accepted, no module") << "nomodules.so" << "nomodules plugin"
                                         << "The plugin nomodules plugin" << QStringList{"|"};
    QTest::newRow("not valid") << "invalid.so" << "" << "The plugin cannot work on this system."
                               << QStringList();
    QTest::newRow("another interface") << "otherinterface.so" << "" << "brel-admin-kvt/0.0"
                                       << QStringList();
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
    const QString path = pluginFile(file);
    QModelIndex top;
    for (int row = 0; row < model->rowCount(); ++row) {
        if (model->index(row, 0).data(Qt::ToolTipRole).toString() == path)
            top = model->index(row, 0);
    }
    QVERIFY2(top.isValid(), qPrintable(path));
    const bool accepted = !name.isEmpty();

    QCOMPARE(top.data().toString(), accepted ? name : path);
    QCOMPARE(top.data(Qt::DecorationRole).value<QIcon>().name(),
             accepted ? QStringLiteral("task-complete") : QStringLiteral("task-reject"));
    const QModelIndex about = top.sibling(top.row(), 1);
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
        const QModelIndex child = model->index(row, 0, top);
        QCOMPARE(child.parent(), top);
        QCOMPARE(model->rowCount(child), 0);
        QCOMPARE(child.data(Qt::ToolTipRole), child.data());
        rows.append(child.data().toString() + QLatin1Char('|')
                    + child.sibling(row, 1).data().toString());
    }
    QCOMPARE(rows, modules);
    // Nothing hangs off column 1.
    QCOMPARE(model->rowCount(about), 0);
}

void PluginContainerTest::dialogForm_data()
{
    QTest::addColumn<QString>("object");
    QTest::addColumn<QString>("className");
    QTest::addColumn<QString>("property");
    QTest::addColumn<QVariant>("value");

    QTest::newRow("dialog") << "PluginDialog" << "PluginDialog" << "windowTitle" << QVariant("Plugins and modules");
    QTest::newRow("modality") << "PluginDialog" << "PluginDialog" << "windowModality"
                              << QVariant::fromValue(Qt::WindowModal);
    QTest::newRow("size") << "PluginDialog" << "PluginDialog" << "size" << QVariant(QSize(400, 300));
    QTest::newRow("layout") << "gridLayout_3" << "QGridLayout" << "" << QVariant();
    QTest::newRow("path label") << "_pathLabelLabel" << "QLabel" << "text" << QVariant("Plugin path:");
    QTest::newRow("path field") << "_pathLineEdit" << "QLineEdit" << "readOnly" << QVariant(true);
    QTest::newRow("change") << "_changePushButton" << "QPushButton" << "text" << QVariant("Change");
    QTest::newRow("tabs") << "_pluginTabWidget" << "QTabWidget" << "currentIndex" << QVariant(0);
    QTest::newRow("plugin tab") << "_pliginTab" << "QWidget" << "tab" << QVariant("Plugins");
    QTest::newRow("plugin tab layout") << "gridLayout" << "QGridLayout" << "" << QVariant();
    QTest::newRow("plugin view") << "_pluginTtreeView" << "QTreeView" << "" << QVariant();
    QTest::newRow("module tab") << "_moduleTab" << "QWidget" << "tab" << QVariant("Modules");
    QTest::newRow("module tab layout") << "gridLayout_2" << "QGridLayout" << "" << QVariant();
    QTest::newRow("module view") << "_moduleTreeView" << "QTreeView" << "" << QVariant();
    QTest::newRow("buttons") << "_buttonBox" << "QDialogButtonBox" << "standardButtons"
                             << QVariant::fromValue(QDialogButtonBox::StandardButtons(QDialogButtonBox::Close));
}

void PluginContainerTest::dialogForm()
{
    QFETCH(QString, object);
    QFETCH(QString, className);
    QFETCH(QString, property);
    QFETCH(QVariant, value);

    PluginDialog *dialog = dialogOf(*container);
    QVERIFY(dialog);
    QObject *found = object == dialog->objectName() ? dialog : dialog->findChild<QObject *>(object);
    QVERIFY2(found, qPrintable(object));
    QCOMPARE(QString::fromLatin1(found->metaObject()->className()), className);
    if (property == QLatin1String("tab")) {
        auto *tabs = dialog->findChild<QTabWidget *>(QStringLiteral("_pluginTabWidget"));
        QCOMPARE(tabs->tabText(tabs->indexOf(qobject_cast<QWidget *>(found))), value.toString());
    } else if (property == QLatin1String("standardButtons")) {
        QCOMPARE(qobject_cast<QDialogButtonBox *>(found)->standardButtons(),
                 value.value<QDialogButtonBox::StandardButtons>());
    } else if (!property.isEmpty()) {
        QVariant actual = found->property(qPrintable(property));
        if (property == QLatin1String("windowModality"))
            QCOMPARE(actual.toInt(), int(value.value<Qt::WindowModality>()));
        else
            QCOMPARE(actual, value);
    }
}

void PluginContainerTest::dialogFollowsContainer()
{
    container->loadPlugins(pluginDir);
    PluginDialog *dialog = dialogOf(*container);
    QVERIFY(dialog);
    auto *modules = dialog->findChild<QTreeView *>(QStringLiteral("_moduleTreeView"));
    QCOMPARE(modules->model(), container->treeNodeModel());
    auto *path = dialog->findChild<QLineEdit *>(QStringLiteral("_pathLineEdit"));

    container->showPluginDialog();
    QVERIFY(QTest::qWaitForWindowExposed(dialog));
    QCOMPARE(path->text(), pluginDir);
    QCOMPARE(path->toolTip(), pluginDir);

    // Loaded while the dialog is open: one reset of the plugin list.
    pluginModelLog->take();
    container->loadPlugins(pluginDir + QStringLiteral("/sub"));
    QCOMPARE(pluginModelLog->take(), QStringList({"aboutToReset", "reset"}));
    QCOMPARE(TreeString::fromModel(modules->model()), QStringLiteral("delta"));

    dialog->findChild<QDialogButtonBox *>()->button(QDialogButtonBox::Close)->click();
    QVERIFY(!dialog->isVisible());
    // Shown again, the field follows the container.
    container->showPluginDialog();
    QCOMPARE(path->text(), pluginDir + QStringLiteral("/sub"));
    dialog->hide();
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
    QPointer<Plugin> loaded;
    for (const PluginContainer::PluginEntry &entry : container->plugins())
        loaded = entry.second ? entry.second : loaded.data();
    PluginDialog *dialog = dialogOf(*container);
    container->showPluginDialog();
    pluginModelLog->take();
    answerer->fileAnswer = answer;

    dialog->findChild<QPushButton *>(QStringLiteral("_changePushButton"))->click();

    QCOMPARE(answerer->fileDialogs,
             QStringList({"Plugin directory|" + pluginDir + "|directories only"}));
    QCOMPARE(bool(loaded), !reloads);
    QCOMPARE(pluginModelLog->take(), reloads ? QStringList({"aboutToReset", "reset"}) : QStringList());
    const QString expected = reloads ? answer : loadedFrom;
    QCOMPARE(container->pluginPath(), expected);
    auto *path = dialog->findChild<QLineEdit *>(QStringLiteral("_pathLineEdit"));
    QCOMPARE(path->text(), expected);
    QCOMPARE(path->toolTip(), expected);
    dialog->hide();
}

void PluginContainerTest::dialogGeometry()
{
    dialogOf(*container)->resize(530, 420);
    container.reset();
    QVERIFY(QSettings().value(QStringLiteral("pluginDialog/pluginDialogGeometry")).isValid());

    PluginContainer again;
    QCOMPARE(dialogOf(again)->size(), QSize(530, 420));
}

void PluginContainerTest::dialogOutlivesContainer()
{
    QWidget window;
    auto *owned = new PluginContainer(&window);
    QPointer<PluginDialog> dialog = dialogOf(*owned);
    QVERIFY(dialog);
    QCOMPARE(dialog->parentWidget(), &window);
    owned->loadPlugins(pluginDir);

    delete owned;

    // The window owns the dialog; it stays usable without its container.
    QVERIFY(dialog);
    dialog->show();
    QCOMPARE(dialog->findChild<QLineEdit *>(QStringLiteral("_pathLineEdit"))->text(), QString());
    QVERIFY(!dialog->findChild<QPushButton *>(QStringLiteral("_changePushButton"))->isEnabled());
    dialog->changePath();
    QVERIFY(answerer->fileDialogs.isEmpty());
    // The models went with the container.
    QVERIFY(!dialog->findChild<QTreeView *>(QStringLiteral("_pluginTtreeView"))->model());
    QVERIFY(!dialog->findChild<QTreeView *>(QStringLiteral("_moduleTreeView"))->model());
    dialog->hide();
}

void PluginContainerTest::elementsOfPlugins()
{
    // Start-up as a tool does it: plugins first, then the element tree of
    // their modules.
    ElementContainer elements;
    QAbstractItemModelTester tester(elements.treeNodeModel(),
                                    QAbstractItemModelTester::FailureReportingMode::QtTest);
    container->loadPlugins(pluginDir);

    elements.pluginContainerReset(container->rootNode());
    QCOMPARE(TreeString::fromTree(elements.rootNode()),
             QStringLiteral("item_alpha-item item_beta-item item_delta-item"));

    // Unloading takes the elements with their modules.
    container->unloadPlugins();
    QCOMPARE(TreeString::fromTree(elements.rootNode()), QString());
    QCOMPARE(elements.treeNodeModel()->rowCount(), 0);
}

void PluginContainerTest::examplePlugin()
{
#ifndef KVT_EXAMPLE_PLUGIN_DIR
    QSKIP("the examples are not built (KVT_BUILD_EXAMPLES is off)");
#else
    const QString directory = QStringLiteral(KVT_EXAMPLE_PLUGIN_DIR);
    ElementContainer elements;
    container->loadPlugins(directory);
    elements.pluginContainerReset(container->rootNode());

    QCOMPARE(acceptedCount(*container), 1);
    QCOMPARE(container->pluginModel()->index(0, 0).data().toString(), QStringLiteral("Hello"));
    QCOMPARE(TreeString::fromTree(container->rootNode()), QStringLiteral("hello"));
    QCOMPARE(TreeString::fromTree(elements.rootNode()),
             QStringLiteral("greeting_evening greeting_morning"));
    QCOMPARE(elements.treeNodeModel()->index(1, 0).data(Qt::ToolTipRole).toString(),
             QStringLiteral("Good morning!"));
    container->unloadPlugins();
    QCOMPARE(TreeString::fromTree(elements.rootNode()), QString());
#endif
}

QTEST_MAIN(PluginContainerTest)
#include "tst_plugincontainer.moc"
