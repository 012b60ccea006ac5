#include <kvt-common/gecosdialog.h>
#include <kvt-common/passworddialog.h>
#include <kvt-common/passwordinputdialog.h>

#include "screenshot.h"

#include <QClipboard>
#include <QDialogButtonBox>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalSpy>
#include <QTimer>
#include <QtTest>

namespace {

QLineEdit *edit(QWidget *dialog, const QString &name)
{
    return dialog->findChild<QLineEdit *>(name);
}

QPushButton *okButton(QWidget *dialog, const QString &boxName = QStringLiteral("_buttonBox"))
{
    auto *box = dialog->findChild<QDialogButtonBox *>(boxName);
    return box ? box->button(QDialogButtonBox::Ok) : nullptr;
}

const QStringList gecosFields = {QStringLiteral("_nameLineEdit"), QStringLiteral("_roomLineEdit"),
                                 QStringLiteral("_phoneLineEdit"), QStringLiteral("_otherLineEdit")};

// The four GECOS fields as "name|room|phone|other".
QString fields(GecosDialog &dialog)
{
    QStringList texts;
    for (const QString &name : gecosFields)
        texts.append(edit(&dialog, name)->text());
    return texts.join(QLatin1Char('|'));
}

// Types into a shown line edit as a user would, one key at a time.
void type(QLineEdit *lineEdit, const QString &text)
{
    lineEdit->setFocus();
    QTest::keyClicks(lineEdit, text);
}

} // namespace

class CredentialDialogsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void passwordDialogOk_data();
    void passwordDialogOk();
    void passwordDialogSetUserAndShow();
    void passwordInputOk_data();
    void passwordInputOk();
    void gecosRoundTrip_data();
    void gecosRoundTrip();
    void gecosRejectsComma_data();
    void gecosRejectsComma();
    void gecosExecFocusesName();
    void screenshots();
};

void CredentialDialogsTest::passwordDialogOk_data()
{
    QTest::addColumn<QString>("user");
    QTest::addColumn<QString>("password");
    QTest::addColumn<bool>("ok");

    QTest::newRow("login, no password") << "root" << "" << false;
    QTest::newRow("one character") << "root" << "x" << true;
    QTest::newRow("password, no login") << "" << "secret" << false;
    QTest::newRow("blanks kept") << " root " << "  " << true;
}

void CredentialDialogsTest::passwordDialogOk()
{
    QFETCH(QString, user);
    QFETCH(QString, password);
    QFETCH(bool, ok);

    PasswordDialog dialog;
    dialog.show();
    QVERIFY(QTest::qWaitForWindowExposed(&dialog));
    // Until a text changes, OK keeps the button box's own state.
    QVERIFY(okButton(&dialog)->isEnabled());
    dialog.checkValid();
    QVERIFY(!okButton(&dialog)->isEnabled());

    // Typing the login alone never makes the pair acceptable.
    type(edit(&dialog, QStringLiteral("_userLineEdit")), user);
    QVERIFY(!okButton(&dialog)->isEnabled());
    type(edit(&dialog, QStringLiteral("_passwordLineEdit")), password);
    QCOMPARE(okButton(&dialog)->isEnabled(), ok);
    QCOMPARE(dialog.user(), user);
    QCOMPARE(dialog.password(), password);

}

void CredentialDialogsTest::passwordDialogSetUserAndShow()
{
    PasswordDialog dialog;
    QLineEdit *login = edit(&dialog, QStringLiteral("_userLineEdit"));
    QSignalSpy changes(login, SIGNAL(textChanged(QString)));

    dialog.setUser(QStringLiteral("alice"));
    QCOMPARE(changes.count(), 1);
    QCOMPARE(dialog.user(), QStringLiteral("alice"));
    login->setCursorPosition(2);
    dialog.setUser(QStringLiteral("alice"));
    QCOMPARE(changes.count(), 0 + 1);
    QCOMPARE(login->cursorPosition(), 2);

    // Showing puts the focus on the login with the whole text selected, so
    // typing replaces it.
    dialog.show();
    QVERIFY(QTest::qWaitForWindowActive(&dialog));
    QCOMPARE(dialog.focusWidget(), login);
    QCOMPARE(login->selectedText(), QStringLiteral("alice"));
    QTest::keyClicks(QApplication::focusWidget(), QStringLiteral("bob"));
    QCOMPARE(dialog.user(), QStringLiteral("bob"));
}

void CredentialDialogsTest::passwordInputOk_data()
{
    QTest::addColumn<QString>("password");
    QTest::addColumn<QString>("repeat");
    QTest::addColumn<bool>("ok");

    QTest::newRow("different") << "abc" << "abd" << false;
    QTest::newRow("same") << "abc" << "abc" << true;
    QTest::newRow("case differs") << "abc" << "aBc" << false;
    QTest::newRow("repeat longer") << "abc" << "abc " << false;
    QTest::newRow("blanks only") << "   " << "   " << true;
    QTest::newRow("repeat only") << "" << "abc" << false;
}

void CredentialDialogsTest::passwordInputOk()
{
    QFETCH(QString, password);
    QFETCH(QString, repeat);
    QFETCH(bool, ok);

    PasswordInputDialog dialog;
    dialog.show();
    QVERIFY(QTest::qWaitForWindowExposed(&dialog));
    type(edit(&dialog, QStringLiteral("_passwordLineEdit")), password);
    type(edit(&dialog, QStringLiteral("_repeatLineEdit")), repeat);
    QCOMPARE(okButton(&dialog)->isEnabled(), ok);
    QCOMPARE(dialog.password(), password);

    // OK is enabled exactly when a user can accept: clicking it then
    // accepts the dialog.
    QSignalSpy accepted(&dialog, SIGNAL(accepted()));
    QTest::mouseClick(okButton(&dialog), Qt::LeftButton);
    QCOMPARE(accepted.count(), ok ? 1 : 0);
}

void CredentialDialogsTest::gecosRoundTrip_data()
{
    QTest::addColumn<QString>("gecos");
    QTest::addColumn<QString>("fields");
    QTest::addColumn<QString>("written");

    QTest::newRow("name and phone") << "John Smith,,555," << "John Smith||555|" << " John Smith,, 555,";
    QTest::newRow("already written") << " John Smith,, 555," << "John Smith||555|" << " John Smith,, 555,";
    QTest::newRow("five parts") << "a,b,c,d,e" << "a|b|c|d" << " a, b, c, d";
    QTest::newRow("no commas") << "Jane Doe" << "Jane Doe|||" << " Jane Doe,,,";
    QTest::newRow("empty") << "" << "|||" << ",,,";
    QTest::newRow("three commas only") << ",,," << "|||" << ",,,";
    QTest::newRow("blanks collapsed") << "  John \t Smith ,  12 b ,," << "John Smith|12 b||"
                                      << " John Smith, 12 b,,";
    QTest::newRow("other only") << ",,,x" << "|||x" << ",,, x";
}

void CredentialDialogsTest::gecosRoundTrip()
{
    QFETCH(QString, gecos);
    QFETCH(QString, fields);
    QFETCH(QString, written);

    GecosDialog dialog;
    // Stale text from an earlier user must not survive.
    dialog.setGecos(QStringLiteral("old,old,old,old"));
    dialog.setGecos(gecos);
    QCOMPARE(::fields(dialog), fields);
    QCOMPARE(dialog.gecos(), written);
    QCOMPARE(dialog.gecos().count(QLatin1Char(',')), 3);

    dialog.setGecos(dialog.gecos());
    QCOMPARE(::fields(dialog), fields);

    dialog.clear();
    QCOMPARE(dialog.gecos(), QStringLiteral(",,,"));
}

void CredentialDialogsTest::gecosRejectsComma_data()
{
    QTest::addColumn<QString>("field");
    for (const QString &field : gecosFields)
        QTest::newRow(qPrintable(field)) << field;
}

void CredentialDialogsTest::gecosRejectsComma()
{
    QFETCH(QString, field);

    GecosDialog dialog;
    dialog.show();
    QVERIFY(QTest::qWaitForWindowExposed(&dialog));
    QLineEdit *lineEdit = edit(&dialog, field);
    type(lineEdit, QStringLiteral("a,b"));
    QCOMPARE(lineEdit->text(), QStringLiteral("ab"));

    // Pasting goes through the same check: text with a comma is refused as
    // a whole, text without one is taken.
    QGuiApplication::clipboard()->setText(QStringLiteral("x,y"));
    QTest::keyClick(lineEdit, Qt::Key_V, Qt::ControlModifier);
    QCOMPARE(lineEdit->text(), QStringLiteral("ab"));
    QGuiApplication::clipboard()->setText(QStringLiteral("xy"));
    QTest::keyClick(lineEdit, Qt::Key_V, Qt::ControlModifier);
    QCOMPARE(lineEdit->text(), QStringLiteral("abxy"));
    QVERIFY(!dialog.gecos().contains(QStringLiteral("x,")));
}

void CredentialDialogsTest::gecosExecFocusesName()
{
    GecosDialog dialog;
    dialog.setGecos(QStringLiteral("a,b,c,d"));
    edit(&dialog, QStringLiteral("_otherLineEdit"))->setFocus();
    QWidget *focused = nullptr;
    QTimer::singleShot(0, &dialog, [&] {
        focused = dialog.focusWidget();
        dialog.reject();
    });
    QCOMPARE(dialog.exec(), int(QDialog::Rejected));
    QCOMPARE(focused, edit(&dialog, QStringLiteral("_nameLineEdit")));
}

void CredentialDialogsTest::screenshots()
{
    PasswordDialog password;
    password.setUser(QStringLiteral("alice"));
    PasswordInputDialog input;
    GecosDialog gecos;
    gecos.setGecos(QStringLiteral("John Smith,101,555-0100,"));
    const QList<QPair<QDialog *, QString>> dialogs = {{&password, QStringLiteral("passworddialog")},
                                                     {&input, QStringLiteral("passwordinputdialog")},
                                                     {&gecos, QStringLiteral("gecosdialog")}};
    QCOMPARE(password.windowTitle(), QStringLiteral("Enter login and password"));
    QCOMPARE(input.windowTitle(), QStringLiteral("Change password"));
    QCOMPARE(gecos.windowTitle(), QStringLiteral("GECOS"));
    QVERIFY(gecos.isModal());
    for (QDialog *d : {static_cast<QDialog *>(&password), static_cast<QDialog *>(&input)})
        for (const char *name : {"_passwordLineEdit", "_repeatLineEdit"})
            QVERIFY(!edit(d, QLatin1String(name)) || edit(d, QLatin1String(name))->echoMode() == QLineEdit::Password);
    QVERIFY(okButton(&gecos, QStringLiteral("buttonBox")));
    for (const auto &entry : dialogs) {
        entry.first->show();
        QVERIFY(QTest::qWaitForWindowExposed(entry.first));
        QVERIFY2(keepScreenshot(entry.first, entry.second), qPrintable(entry.second));
        entry.first->hide();
    }
}

QTEST_MAIN(CredentialDialogsTest)
#include "tst_credentialdialogs.moc"
