// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/module.h>
#include <kvt-common/plugin.h>
#include <kvt-common/plugincontainer.h>
#include <kvt-common/pluginmodel.h>
#include <kvt-common/treenodemodel.h>

#include "dialoganswerer.h"
#include "signallog.h"
#include "treestring.h"

#include <QApplication>
#include <QPushButton>
#include <QTimer>
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

} // namespace

class PluginContainerTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<PluginContainer> container;
    std::unique_ptr<QAbstractItemModelTester> pluginModelTester, moduleModelTester;
    SignalLog *pluginModelLog = nullptr;

private Q_SLOTS:
    void initTestCase()
    {
        qRegisterMetaType<const TreeNode *>();
        qRegisterMetaType<TreeNode *>();
    }

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
    }

    void loadAndUnload()
    {
        // Loaded twice: the second load replaces the first, and listeners see
        // one reset, not the unload inside it.
        container->loadPlugins(pluginDir);
        const QList<QPointer<Plugin>> first = acceptedPlugins(*container);
        pluginModelLog->take();
        QSignalSpy reset(container.get(), SIGNAL(nodeContainerReset(const TreeNode *)));
        QApplication::setOverrideCursor(Qt::WaitCursor);

        container->loadPlugins(pluginDir);

        QCOMPARE(first.count(nullptr), first.size());
        QCOMPARE(TreeString::fromModel(container->treeNodeModel()), QStringLiteral("alpha[alpha-child] beta delta"));
        // A plugin adds its mask only with a module: not 8 (not valid) nor 16 (no module).
        QCOMPARE(container->availableOperationsClass(), quint64(1 | 2 | 4));
        QCOMPARE(acceptedPlugins(*container).size(), 4);
        QCOMPARE(container->plugins().size(), 7);
        QCOMPARE(reset.value(0).value(0).value<const TreeNode *>(), container->rootNode());
        QCOMPARE(pluginModelLog->take(), oneReset);
        // The caller's wait cursor is the caller's to restore.
        QVERIFY(QApplication::overrideCursor());

        // Requests of every module, at every depth, reach the container.
        QSignalSpy content(container.get(), SIGNAL(contentElementWidgetChanged(int)));
        QSignalSpy menu(container.get(), SIGNAL(customContextMenuRequested(QPoint)));
        QSignalSpy current(container.get(), SIGNAL(setCurrentNode(TreeNode *)));
        for (TreeNode *node : container->modules()) {
            auto *module = qobject_cast<Module *>(node);
            Q_EMIT module->contentElementWidgetChanged(3);
            Q_EMIT module->customContextMenuRequested(QPoint(4, 5));
            module->emitSetCurrentNode();
        }
        QCOMPARE(QVector<int>({content.count(), menu.count(), current.count()}), QVector<int>(3, 4));

        // Unloading takes every plugin and module, announced as one reset.
        const QList<QPointer<Plugin>> second = acceptedPlugins(*container);
        container->unloadPlugins();
        QCOMPARE(second.count(nullptr), second.size());
        QVERIFY(container->modules().isEmpty() && container->plugins().isEmpty() && container->pluginPath().isEmpty());
        QCOMPARE(container->availableOperationsClass(), quint64(0));
        QCOMPARE(reset.count(), 2);
        QCOMPARE(pluginModelLog->take(), oneReset);
    }

    void missingDirectory()
    {
        const QString path = pluginDir + "/nothing/here";
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
        QVERIFY(reset.isEmpty() && container->plugins().isEmpty() && container->modules().isEmpty());
        QCOMPARE(container->pluginPath(), path);

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
        QTest::newRow("not valid") << "invalid.so" << "" << "The plugin cannot work on this system. It needs a host it does not have."
                                   << QStringList();
        QTest::newRow("not a shared object") << "broken.so" << "" << "broken.so" << QStringList();
    }

    void pluginModel()
    {
        QFETCH(QString, file);
        QFETCH(QString, name);
        QFETCH(QString, description);

        container->loadPlugins(pluginDir);
        PluginModel *model = container->pluginModel();
        const QString path = pluginDir + QLatin1Char('/') + file;
        const QModelIndex top = model->match(model->index(0, 0), Qt::ToolTipRole, path, 1, Qt::MatchExactly).value(0);
        const QString about = top.sibling(top.row(), 1).data().toString();
        const bool accepted = !name.isEmpty();

        QCOMPARE(top.data().toString(), accepted ? name : path);
        // A refused file says why, readable by a person.
        QVERIFY2(accepted ? about == description : about.contains(description) && !about.contains("Unknown error"),
                 qPrintable(about));

        QStringList rows;
        for (int r = 0; r < model->rowCount(top); ++r)
            rows.append(model->index(r, 0, top).data().toString() + '|' + model->index(r, 1, top).data().toString());
        QTEST(rows, "modules");
    }

    void reentrantLoad()
    {
        // Events are processed between files and between a plugin's modules.
        // A load or unload asked for meanwhile (here by a timer firing at each
        // pass) waits until the running load is done, and the plugin dialog
        // offers no Change during it.
        container->showPluginDialog();
        QPushButton *change = nullptr;
        for (QWidget *w : QApplication::topLevelWidgets())
            if (!change && w->inherits("PluginDialog"))
                change = w->findChild<QPushButton *>(QStringLiteral("_changePushButton"));
        QVERIFY(change && change->isEnabled());

        int ticks = 0;
        QStringList changeOffered;
        QTimer timer;
        timer.setInterval(0);
        connect(&timer, &QTimer::timeout, this, [&] {
            changeOffered.append(change->isEnabled() ? "yes" : "no");
            if (++ticks == 3)
                container->unloadPlugins();
            else if (ticks < 20)
                container->loadPlugins(pluginDir);
            else
                timer.stop();
        });
        timer.start();
        container->loadPlugins(pluginDir);
        timer.stop();

        QVERIFY2(ticks > 12, "the timer fired between files and between modules");
        QVERIFY(!changeOffered.isEmpty() && !changeOffered.contains(QStringLiteral("yes")));
        QVERIFY(change->isEnabled());
        // The last request was a load: one set of plugins and modules.
        QCOMPARE(TreeString::fromModel(container->treeNodeModel()), QStringLiteral("alpha[alpha-child] beta delta"));
        QCOMPARE(container->plugins().size(), 7);
        QCOMPARE(container->modules().size(), 4);
    }
};

QTEST_MAIN(PluginContainerTest)
#include "tst_plugincontainer.moc"
