// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// The services plugin: how services are found on a host, and, through
// kvt-admin's window, a real service listed, read, started and stopped.

#include "admintest.h"
#include "dialoganswerer.h"
#include "hostfixtures.h"
#include "mainwindow.h"
#include "servicebackend.h"
#include "workerthreads.h"

#include <kvt-common/element.h>
#include <kvt-common/elementtreeview.h>
#include <kvt-common/elementwidgetcontainer2.h>
#include <kvt-common/servicelightelementdata.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/taskobserverdialog.h>

#include <QAbstractItemModelTester>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QPlainTextEdit>
#include <QTemporaryDir>
#include <QTest>
#include <QToolButton>

#include <unistd.h>

using namespace AdminTest;

namespace {

// The state an element's icon shows: "running", "stopped" or "unknown".
QString shownState(Element *element)
{
    auto *state = element ? dynamic_cast<ServiceLightElementData *>(element->elementData()) : nullptr;
    if (!state || state->textState().isEmpty())
        return QStringLiteral("unknown");
    return state->state() ? QStringLiteral("running") : QStringLiteral("stopped");
}

bool clickButton(MainWindow &window, const char *name)
{
    auto *button = window.widgetContainer()->findChild<QToolButton *>(QLatin1String(name));
    if (!button || !button->isEnabled())
        return false;
    QTest::mouseClick(button, Qt::LeftButton);
    return true;
}

} // namespace

class TestServices : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void cleanup();
    void cleanupTestCase();

    void parseUnitFiles_data();
    void parseUnitFiles();
    void initScripts();
    void detect();

    void startAndStopRealService();
    void readOnlyWithoutAllowChanges();

private:
    std::unique_ptr<WorkerThreads> _workers;
    // Closed by cleanup(), also after a failed check.
    std::unique_ptr<MainWindow> _window;
};

void TestServices::initTestCase()
{
    QCoreApplication::setOrganizationName(QStringLiteral("kvt-admin"));
    QCoreApplication::setApplicationName(QStringLiteral("kvt-admin"));
    _workers = std::make_unique<WorkerThreads>(2);
}

void TestServices::cleanup()
{
    QVERIFY(HostFixtures::closeWindow(_window));
    qApp->setProperty("kvtAdminAllowChanges", QVariant());
}

void TestServices::cleanupTestCase()
{
    _workers.reset();
}

void TestServices::parseUnitFiles_data()
{
    QTest::addColumn<QString>("output");
    QTest::addColumn<QStringList>("services");

    QTest::newRow("states and presets, sorted")
        << "ssh.service    enabled enabled\ncron.service enabled enabled\n"
        << QStringList{"cron", "ssh"};
    QTest::newRow("templates and other unit kinds skipped")
        << "getty@.service enabled enabled\nfoo.socket enabled enabled\npostgresql@.service indirect\n"
           "postgresql.service enabled enabled\n"
        << QStringList{"postgresql"};
    QTest::newRow("names a program would take as options or paths")
        << "-x.service enabled\nbad\x01name.service enabled\nok.service masked\n" << QStringList{"ok"};
    QTest::newRow("empty output") << "" << QStringList();
}

void TestServices::parseUnitFiles()
{
    QFETCH(QString, output);
    QFETCH(QStringList, services);
    QCOMPARE(ServiceBackend::parseUnitFiles(output), services);
}

void TestServices::initScripts()
{
    QTemporaryDir dir;
    QVERIFY(dir.isValid());
    const auto make = [&](const QString &name, bool executable) {
        QFile file(dir.filePath(name));
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.write("#!/bin/sh\n");
        file.close();
        file.setPermissions(executable ? QFileDevice::ReadOwner | QFileDevice::ExeOwner : QFileDevice::ReadOwner);
    };
    for (const char *name : {"postgresql", "dbus", "README", "skeleton", "rcS", "-weird", "cron.dpkg-old"})
        make(QLatin1String(name), true);
    make(QStringLiteral("notexec"), false);
    QVERIFY(QDir(dir.path()).mkdir(QStringLiteral("subdir")));
    QCOMPARE(ServiceBackend::initScripts(dir.path()), QStringList({"dbus", "postgresql"}));
}

void TestServices::detect()
{
    QTemporaryDir dir;
    QVERIFY(dir.isValid());
    const QString runDir = dir.filePath(QStringLiteral("run-systemd"));
    const QString initDir = dir.filePath(QStringLiteral("init.d"));
    QVERIFY(QDir().mkpath(initDir));

    // Neither systemd nor scripts: nothing to manage, and the reason names the folder.
    ServiceBackend none = ServiceBackend::detect(runDir, initDir);
    QVERIFY(!none.isValid());
    QVERIFY(none.unavailableReason().contains(initDir));

    QFile script(initDir + QStringLiteral("/demo"));
    QVERIFY(script.open(QIODevice::WriteOnly));
    script.close();
    script.setPermissions(QFileDevice::ReadOwner | QFileDevice::ExeOwner);
    ServiceBackend sysv = ServiceBackend::detect(runDir, initDir);
    QCOMPARE(sysv.kind(), ServiceBackend::SysV);
    QCOMPARE(sysv.program(), QStringLiteral("service"));
    QVERIFY(!sysv.commandFirst());
    QCOMPARE(sysv.serviceArguments(QStringLiteral("demo")), QStringList{"demo"});

    // A running systemd wins over the scripts.
    QVERIFY(QDir().mkpath(runDir));
    ServiceBackend systemd = ServiceBackend::detect(runDir, initDir);
    QCOMPARE(systemd.kind(), ServiceBackend::Systemd);
    QVERIFY(systemd.commandFirst());
    QCOMPARE(systemd.serviceArguments(QStringLiteral("demo")).last(), QStringLiteral("demo.service"));
    QVERIFY(systemd.unavailableReason().isEmpty());
}

void TestServices::startAndStopRealService()
{
    const QString why = HostFixtures::whyNoPostgresql();
    if (!why.isEmpty())
        QSKIP(qPrintable(why));
    if (ServiceBackend::detect().kind() != ServiceBackend::SysV)
        QSKIP("the test service is an init script; this host runs systemd");

    // A service of its own: an init script driving a throw-away cluster.
    const QString name = QStringLiteral("kvtsvc%1").arg(::getpid());
    HostFixtures::Cluster cluster(name);
    QVERIFY(cluster.isValid());
    HostFixtures::InitScript script(name, cluster);
    QVERIFY(script.isValid());

    qApp->setProperty("kvtAdminAllowChanges", true);
    DialogAnswerer answerer;
    _window = openMainWindow();
    QAbstractItemModelTester tester(_window->elementView()->model(),
                                    QAbstractItemModelTester::FailureReportingMode::QtTest);
    QVERIFY(chooseModule(*_window, QStringLiteral("services")));

    // The machine's own services are listed beside the test's.
    QVERIFY(chooseElement(*_window, {QStringLiteral("Services"), QStringLiteral("postgresql")}));
    Element *service = chooseElement(*_window, {QStringLiteral("Services"), name});
    QVERIFY(service);
    QTRY_COMPARE_WITH_TIMEOUT(shownState(service), QStringLiteral("stopped"), 20000);

    // The widget shows the status command's own output.
    auto *status = _window->widgetContainer()->findChild<QPlainTextEdit *>(QStringLiteral("_statusPlainTextEdit"));
    QVERIFY(status);
    QTRY_VERIFY(status->toPlainText().contains(QStringLiteral("no server running")));
    auto *state = _window->widgetContainer()->findChild<QLabel *>(QStringLiteral("_stateLabel"));
    QCOMPARE(state->text(), QStringLiteral("stopped"));
    screenshot(_window.get(), QStringLiteral("kvt-admin-service"));

    // Start: the icon and the open widget follow, and the cluster runs.
    QVERIFY(clickButton(*_window, "_serviceStartActionToolButton"));
    QVERIFY(waitIdle(60000));
    QCOMPARE(shownState(service), QStringLiteral("running"));
    QCOMPARE(state->text(), QStringLiteral("started"));
    QVERIFY(cluster.isOnline());
    QVERIFY(!_window->widgetContainer()->findChild<QToolButton *>(QStringLiteral("_serviceStartActionToolButton"))->isEnabled());

    // Stop, this time in force reread mode: the state is read back from the host.
    service->module().setData(1, Qt::Checked, Qt::CheckStateRole);
    QVERIFY(clickButton(*_window, "_serviceStopActionToolButton"));
    QVERIFY(waitIdle(60000));
    QTRY_COMPARE_WITH_TIMEOUT(shownState(service), QStringLiteral("stopped"), 20000);
    QTRY_VERIFY(status->toPlainText().contains(QStringLiteral("no server running")));
    QVERIFY(!cluster.isOnline());
    service->module().setData(1, Qt::Unchecked, Qt::CheckStateRole);

}

void TestServices::readOnlyWithoutAllowChanges()
{
    if (ServiceBackend::detect().kind() == ServiceBackend::None)
        QSKIP("this host has no service to list");
    qApp->setProperty("kvtAdminAllowChanges", QVariant());
    _window = openMainWindow();
    QVERIFY(chooseModule(*_window, QStringLiteral("services")));
    QVERIFY(_window->currentModule()->data(2, Qt::DisplayRole).toString().contains(QStringLiteral("--allow-changes")));
    const QStringList services = ServiceBackend::detect().listServices(nullptr);
    QVERIFY(!services.isEmpty());
    Element *service = chooseElement(*_window, {QStringLiteral("Services"), services.first()});
    QVERIFY(service);
    QVERIFY(!service->isEditable());
    // Read, but none of the control actions is offered.
    QTRY_VERIFY_WITH_TIMEOUT(shownState(service) != QStringLiteral("unknown"), 20000);
    for (const char *button : {"_serviceStartActionToolButton", "_serviceStopActionToolButton",
                               "_serviceRestartActionToolButton", "_serviceReloadActionToolButton"})
        QVERIFY2(!_window->widgetContainer()->findChild<QToolButton *>(QLatin1String(button))->isEnabled(), button);
}

QTEST_MAIN(TestServices)

#include "tst_services.moc"
