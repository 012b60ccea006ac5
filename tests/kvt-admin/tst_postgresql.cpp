// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// The PostgreSQL plugin through kvt-admin's window, on a throw-away cluster:
// listed, started, its users read, a user created and dropped through the
// dialogs, and a name the library refuses reported in the task list.

#include "admintest.h"
#include "dialoganswerer.h"
#include "hostfixtures.h"
#include "mainwindow.h"
#include "workerthreads.h"

#include <kvt-common/element.h>
#include <kvt-common/elementtreeview.h>
#include <kvt-common/elementwidgetcontainer2.h>
#include <kvt-common/taskobserver.h>

#include <QAbstractItemModelTester>
#include <QAction>
#include <QDialog>
#include <QLabel>
#include <QLineEdit>
#include <QProcess>
#include <QTest>
#include <QToolButton>

#include <unistd.h>

using namespace AdminTest;

namespace {

QString label(MainWindow &window, const char *name)
{
    auto *found = window.widgetContainer()->findChild<QLabel *>(QLatin1String(name));
    return found ? found->text() : QStringLiteral("<no %1>").arg(QLatin1String(name));
}

QStringList childTitles(Element *element)
{
    QStringList titles;
    for (TreeNode *node : element->childNodes())
        titles << static_cast<Element *>(node)->title();
    return titles;
}

// Whether \a user logs in to the cluster over TCP with \a password.
bool logsIn(const HostFixtures::Cluster &cluster, const QString &user, const QString &password)
{
    QProcess psql;
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    environment.insert(QStringLiteral("PGPASSWORD"), password);
    psql.setProcessEnvironment(environment);
    psql.start(QStringLiteral("psql"), {QStringLiteral("-X"), QStringLiteral("-h"), QStringLiteral("127.0.0.1"),
                                        QStringLiteral("-p"), QString::number(cluster.port()), QStringLiteral("-U"),
                                        user, QStringLiteral("-d"), QStringLiteral("postgres"),
                                        QStringLiteral("-c"), QStringLiteral("SELECT 1")});
    return psql.waitForFinished(30000) && psql.exitStatus() == QProcess::NormalExit && psql.exitCode() == 0;
}

// Fills the library's credential dialog when it comes up.
void answerCredentials(DialogAnswerer &answerer, const QString &user, const QString &password)
{
    answerer.inspect = [user, password](QDialog *dialog) {
        typeInto(dialog->findChild<QLineEdit *>(QStringLiteral("_userLineEdit")), user);
        typeInto(dialog->findChild<QLineEdit *>(QStringLiteral("_passwordLineEdit")), password);
    };
    answerer.answer(QMessageBox::Ok);
}

} // namespace

class TestPostgresql : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void cleanup();
    void cleanupTestCase();
    void clusterLifeAndUsers();

private:
    std::unique_ptr<WorkerThreads> _workers;
    // Closed by cleanup(), also after a failed check.
    std::unique_ptr<MainWindow> _window;
};

void TestPostgresql::initTestCase()
{
    QCoreApplication::setOrganizationName(QStringLiteral("kvt-admin"));
    QCoreApplication::setApplicationName(QStringLiteral("kvt-admin"));
    _workers = std::make_unique<WorkerThreads>(2);
}

void TestPostgresql::cleanup()
{
    QVERIFY(HostFixtures::closeWindow(_window));
    qApp->setProperty("kvtAdminAllowChanges", QVariant());
}

void TestPostgresql::cleanupTestCase()
{
    _workers.reset();
}

void TestPostgresql::clusterLifeAndUsers()
{
    const QString why = HostFixtures::whyNoPostgresql();
    if (!why.isEmpty())
        QSKIP(qPrintable(why));
    HostFixtures::Cluster cluster(QStringLiteral("kvtpg%1").arg(::getpid()));
    QVERIFY(cluster.isValid());
    const QString user = QStringLiteral("kvt_user_%1").arg(::getpid());
    const QString password = QStringLiteral("it's s3cret \"quoted\"");

    qApp->setProperty("kvtAdminAllowChanges", true);
    DialogAnswerer answerer;
    _window = openMainWindow();
    QAbstractItemModelTester tester(_window->elementView()->model(),
                                    QAbstractItemModelTester::FailureReportingMode::QtTest);
    QVERIFY(chooseModule(*_window, QStringLiteral("postgresql")));
    const QStringList clusterPath{QStringLiteral("PostgreSQL clusters"), cluster.title()};

    // Listed with its port and state; a stopped cluster offers Start only.
    Element *element = chooseElement(*_window, clusterPath, 20000);
    QVERIFY(element);
    QCOMPARE(label(*_window, "_portLabel"), QString::number(cluster.port()));
    QCOMPARE(label(*_window, "_statusLabel"), QStringLiteral("down"));
    QVERIFY(!action(*_window, "createAction")->isEnabled());

    auto *start = _window->widgetContainer()->findChild<QToolButton *>(QStringLiteral("_pgsqlStartClusterActionToolButton"));
    QVERIFY(start && start->isEnabled());
    QTest::mouseClick(start, Qt::LeftButton);
    QVERIFY(waitIdle(60000));
    QTRY_COMPARE_WITH_TIMEOUT(label(*_window, "_statusLabel"), QStringLiteral("online"), 30000);
    QVERIFY(cluster.isOnline());
    QVERIFY(!start->isEnabled());

    // Its users are read when it is opened.
    QVERIFY(chooseElement(*_window, clusterPath + QStringList{QStringLiteral("postgres")}, 20000));
    QCOMPARE(childTitles(element), QStringList{"postgres"});

    // Create a user: name and password through the credential dialog, then Apply.
    QVERIFY(chooseElement(*_window, clusterPath));
    answerCredentials(answerer, user, password);
    QVERIFY(trigger(*_window, "createAction"));
    QTRY_VERIFY(answerer.seen.contains(QStringLiteral("dialog:PasswordDialog")));
    QTRY_VERIFY(action(*_window, "applyAction")->isEnabled());
    QVERIFY(trigger(*_window, "applyAction"));
    QVERIFY(waitIdle(60000));
    QTRY_VERIFY(childTitles(element).contains(user));
    QVERIFY(cluster.users().contains(user));
    QVERIFY(logsIn(cluster, user, password));
    QVERIFY(!logsIn(cluster, user, QStringLiteral("wrong")));

    // Drop it, after the element's removal question.
    QVERIFY(chooseElement(*_window, clusterPath + QStringList{user}));
    answerer.answer(QMessageBox::Yes);
    QVERIFY(trigger(*_window, "deleteAction"));
    QVERIFY(waitIdle(60000));
    QVERIFY(answerer.seen.last().contains(QStringLiteral("drop the database user %1").arg(user)));
    QTRY_VERIFY(!childTitles(element).contains(user));
    QVERIFY(!cluster.users().contains(user));

    // A name that is no plain identifier is refused before any shell sees
    // it, and the task list says why.
    QVERIFY(chooseElement(*_window, clusterPath));
    answerCredentials(answerer, QStringLiteral("x; drop user postgres"), password);
    QVERIFY(trigger(*_window, "createAction"));
    QTRY_VERIFY(action(*_window, "applyAction")->isEnabled());
    QVERIFY(trigger(*_window, "applyAction"));
    QVERIFY(waitIdle(60000));
    bool reported = false;
    for (const TaskObserver::Row &row : TaskObserver::instance()->rows()) {
        if (row.description.status() == TaskDescription::Fail
            && row.description.message().contains(QStringLiteral("is not a plain SQL identifier")))
            reported = true;
    }
    QVERIFY(reported);
    QVERIFY(cluster.users().contains(QStringLiteral("postgres")));

}

QTEST_MAIN(TestPostgresql)

#include "tst_postgresql.moc"
