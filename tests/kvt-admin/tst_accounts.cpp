// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// The accounts plugin through kvt-admin's window, on a throw-away user and
// group: user information, group membership and password changed through
// the library's dialogs land in the account databases; without
// --allow-changes everything is read-only.

#include "admintest.h"
#include "dialoganswerer.h"
#include "hostfixtures.h"
#include "mainwindow.h"
#include "workerthreads.h"

#include <kvt-common/choicedialog.h>
#include <kvt-common/choicewidget.h>
#include <kvt-common/element.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/elementtreeview.h>
#include <kvt-common/elementwidgetcontainer2.h>
#include <kvt-common/taskobserver.h>

#include <QAbstractItemModelTester>
#include <QAction>
#include <QDialog>
#include <QDialogButtonBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTest>
#include <QTreeView>

#include <unistd.h>

using namespace AdminTest;

namespace {

QString label(MainWindow &window, const char *name)
{
    auto *found = window.widgetContainer()->findChild<QLabel *>(QLatin1String(name));
    return found ? found->text() : QStringLiteral("<no %1>").arg(QLatin1String(name));
}

QPushButton *button(MainWindow &window, const char *name)
{
    return window.widgetContainer()->findChild<QPushButton *>(QLatin1String(name));
}

// Selects the row showing \a name in the tree view \a viewName below \a parent.
bool selectRow(QWidget *parent, const char *viewName, const QString &name)
{
    auto *view = parent->findChild<QTreeView *>(QLatin1String(viewName));
    if (!view)
        return false;
    QAbstractItemModel *model = view->model();
    for (int row = 0; row < model->rowCount(); ++row) {
        const QModelIndex index = model->index(row, 0);
        if (index.data().toString() == name) {
            view->selectionModel()->select(index, QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
            return true;
        }
    }
    return false;
}

// The password state "passwd -S" gives: P usable, L locked, NP none.
QString passwordState(const QString &user)
{
    QString output;
    HostFixtures::run(QStringLiteral("passwd"), {QStringLiteral("-S"), user}, &output);
    return output.section(QLatin1Char(' '), 1, 1);
}

} // namespace

class TestAccounts : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanup();
    void cleanupTestCase();

    void changesLandInTheDatabases();
    void readOnlyWithoutAllowChanges();

private:
    std::unique_ptr<WorkerThreads> _workers;
    std::unique_ptr<HostFixtures::Account> _account;
    std::unique_ptr<MainWindow> _window;
    DialogAnswerer *_answerer = nullptr;
};

void TestAccounts::initTestCase()
{
    QCoreApplication::setOrganizationName(QStringLiteral("kvt-admin"));
    QCoreApplication::setApplicationName(QStringLiteral("kvt-admin"));
    _workers = std::make_unique<WorkerThreads>(2);
}

void TestAccounts::init()
{
    const QString why = HostFixtures::whyNotRoot();
    if (!why.isEmpty())
        QSKIP(qPrintable(why));
    _account = std::make_unique<HostFixtures::Account>(QStringLiteral("kvtu%1").arg(::getpid()),
                                                       QStringLiteral("kvtg%1").arg(::getpid()));
    QVERIFY(_account->isValid());
    _answerer = new DialogAnswerer(this);
}

void TestAccounts::cleanup()
{
    QVERIFY(HostFixtures::closeWindow(_window));
    delete _answerer;
    _answerer = nullptr;
    _account.reset();
    qApp->setProperty("kvtAdminAllowChanges", QVariant());
}

void TestAccounts::cleanupTestCase()
{
    _workers.reset();
}

void TestAccounts::changesLandInTheDatabases()
{
    const QString user = _account->user();
    const QString group = _account->group();
    qApp->setProperty("kvtAdminAllowChanges", true);
    _window = openMainWindow();
    QAbstractItemModelTester tester(_window->elementView()->model(),
                                    QAbstractItemModelTester::FailureReportingMode::QtTest);
    QVERIFY(chooseModule(*_window, QStringLiteral("accounts")));
    QVERIFY(chooseElement(*_window, {QStringLiteral("Users"), QStringLiteral("root")}));
    QVERIFY(chooseElement(*_window, {QStringLiteral("Users"), user}));
    QCOMPARE(label(*_window, "_userLabel"), user);
    QCOMPARE(label(*_window, "_fullNameLabel"), QStringLiteral("Test User"));
    QCOMPARE(label(*_window, "_phoneLabel"), QStringLiteral("2"));
    QCOMPARE(label(*_window, "_groupsLabel"), user);

    // GECOS through the library's dialog, written by chfn.
    _answerer->inspect = [](QDialog *dialog) {
        typeInto(dialog->findChild<QLineEdit *>(QStringLiteral("_nameLineEdit")), QStringLiteral("Ann  Other"));
        typeInto(dialog->findChild<QLineEdit *>(QStringLiteral("_roomLineEdit")), QStringLiteral("B 12"));
        typeInto(dialog->findChild<QLineEdit *>(QStringLiteral("_phoneLineEdit")), QString());
        typeInto(dialog->findChild<QLineEdit *>(QStringLiteral("_otherLineEdit")), QStringLiteral("555"));
    };
    _answerer->answer(QMessageBox::Ok);
    QTest::mouseClick(button(*_window, "_gecosPushButton"), Qt::LeftButton);
    QVERIFY(waitIdle(30000));
    QCOMPARE(_answerer->seen.last(), QStringLiteral("dialog:GecosDialog"));
    QCOMPARE(_account->passwdLine().section(QLatin1Char(':'), 4, 4), QStringLiteral("Ann Other,B 12,,555"));
    QTRY_COMPARE(label(*_window, "_fullNameLabel"), QStringLiteral("Ann Other"));

    // A group through the choice dialog, applied by usermod; then taken away
    // again with Remove, applied by gpasswd.
    auto *choice = _window->widgetContainer()->findChild<ChoiceWidget *>(QStringLiteral("_groupsChoiceWidget"));
    QTest::mouseClick(choice->findChild<QPushButton *>(QStringLiteral("_addPushButton")), Qt::LeftButton);
    QDialog *choose = choice->choiceDialog();
    QTRY_VERIFY(choose->isVisible());
    QVERIFY(selectRow(choose, "_nodeTreeView", group));
    QTest::mouseClick(choose->findChild<QDialogButtonBox *>()->button(QDialogButtonBox::Ok), Qt::LeftButton);
    QTRY_VERIFY(action(*_window, "applyAction")->isEnabled());
    QVERIFY(trigger(*_window, "applyAction"));
    QVERIFY(waitIdle(30000));
    QCOMPARE(_account->groupLine().section(QLatin1Char(':'), 3), user);
    QTRY_COMPARE(label(*_window, "_groupsLabel"), QStringLiteral("%1, %2").arg(user, group));

    QVERIFY(selectRow(choice, "_nodeTreeView", group));
    QTest::mouseClick(choice->findChild<QPushButton *>(QStringLiteral("_removePushButton")), Qt::LeftButton);
    QVERIFY(trigger(*_window, "applyAction"));
    QVERIFY(waitIdle(30000));
    QCOMPARE(_account->groupLine().section(QLatin1Char(':'), 3), QString());
    // The primary group cannot be chosen away.
    QVERIFY(!selectRow(choice, "_nodeTreeView", QStringLiteral("nonexistent")));

    // A password through the library's dialog, read by chpasswd on its input.
    QCOMPARE(passwordState(user), QStringLiteral("L"));
    _answerer->inspect = [](QDialog *dialog) {
        typeInto(dialog->findChild<QLineEdit *>(QStringLiteral("_passwordLineEdit")), QStringLiteral("n3w:pass word"));
        typeInto(dialog->findChild<QLineEdit *>(QStringLiteral("_repeatLineEdit")), QStringLiteral("n3w:pass word"));
    };
    _answerer->answer(QMessageBox::Ok);
    QTest::mouseClick(button(*_window, "_passwordPushButton"), Qt::LeftButton);
    QVERIFY(waitIdle(30000));
    QCOMPARE(passwordState(user), QStringLiteral("P"));
    for (const TaskObserver::Row &row : TaskObserver::instance()->rows())
        QVERIFY2(!row.description.message().contains(QStringLiteral("pass word")), qPrintable(row.description.message()));
}

void TestAccounts::readOnlyWithoutAllowChanges()
{
    _window = openMainWindow();
    QVERIFY(chooseModule(*_window, QStringLiteral("accounts")));
    QVERIFY(_window->currentModule()->data(2, Qt::DisplayRole).toString().contains(QStringLiteral("--allow-changes")));
    QVERIFY(chooseElement(*_window, {QStringLiteral("Users"), _account->user()}));
    QCOMPARE(label(*_window, "_userLabel"), _account->user());
    QVERIFY(!button(*_window, "_gecosPushButton")->isEnabled());
    QVERIFY(!button(*_window, "_passwordPushButton")->isEnabled());
    auto *choice = _window->widgetContainer()->findChild<QWidget *>(QStringLiteral("_groupsChoiceWidget"));
    QVERIFY(!choice->findChild<QPushButton *>(QStringLiteral("_addPushButton"))->isEnabled());
    QVERIFY(!action(*_window, "applyAction")->isEnabled());
    QVERIFY(!action(*_window, "createAction")->isEnabled());
    QVERIFY(!action(*_window, "deleteAction")->isEnabled());
    // A change asked for anyway is not made.
    const QString before = _account->passwdLine();
    auto *data = new ElementData;
    data->insert(QStringLiteral("gecos"), QStringLiteral("Intruder,,,"));
    _window->currentElement()->performOperation(LoginExtraOperation1, data, 0);
    QVERIFY(waitIdle());
    QCOMPARE(_account->passwdLine(), before);
}

QTEST_MAIN(TestAccounts)

#include "tst_accounts.moc"
