// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/gecosdialog.h>
#include <kvt-common/passworddialog.h>
#include <kvt-common/passwordinputdialog.h>

#include "screenshot.h"

#include <QtTest>
#include <QtWidgets>

namespace {

QLineEdit *edit(QWidget *dialog, const char *name) { return dialog->findChild<QLineEdit *>(QLatin1String(name)); }

QPushButton *okButton(QWidget *dialog)
{
    return dialog->findChild<QDialogButtonBox *>(QStringLiteral("_buttonBox"))->button(QDialogButtonBox::Ok);
}

// Shows the dialog and types into each named line edit, one key at a time.
bool showAndType(QDialog *dialog, const QList<QPair<const char *, QString>> &texts = {})
{
    dialog->show();
    const bool exposed = QTest::qWaitForWindowExposed(dialog);
    for (const auto &text : texts) {
        edit(dialog, text.first)->setFocus();
        QTest::keyClicks(edit(dialog, text.first), text.second);
    }
    return exposed;
}

} // namespace

class CredentialDialogsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void okNeedsBothTexts_data()
    {
        QTest::addColumn<bool>("repeat"); // a PasswordInputDialog, else a PasswordDialog
        QTest::addColumn<QString>("first");
        QTest::addColumn<QString>("second");
        QTest::addColumn<bool>("ok");

        QTest::newRow("login, no password") << false << "root" << "" << false;
        QTest::newRow("login, one character") << false << "root" << "x" << true;
        QTest::newRow("password, no login") << false << "" << "secret" << false;
        QTest::newRow("repeat differs in case") << true << "abc" << "aBc" << false;
        QTest::newRow("repeated, blanks too") << true << "   " << "   " << true;
    }

    void okNeedsBothTexts()
    {
        QFETCH(bool, repeat);
        QFETCH(QString, first);
        QFETCH(QString, second);
        QFETCH(bool, ok);

        PasswordDialog login;
        PasswordInputDialog input;
        QDialog *dialog = repeat ? static_cast<QDialog *>(&input) : &login;
        const char *firstName = repeat ? "_passwordLineEdit" : "_userLineEdit";
        const char *secondName = repeat ? "_repeatLineEdit" : "_passwordLineEdit";
        for (const char *secret : {"_passwordLineEdit", secondName})
            QCOMPARE(edit(dialog, secret)->echoMode(), QLineEdit::Password);
        QVERIFY(okButton(dialog)->isEnabled()); // until a text changes, OK keeps the button box's own state
        QVERIFY(showAndType(dialog, {{firstName, first}, {secondName, second}}));
        QCOMPARE(okButton(dialog)->isEnabled(), ok);
        QSignalSpy accepted(dialog, SIGNAL(accepted()));
        QTest::mouseClick(okButton(dialog), Qt::LeftButton);
        QCOMPARE(accepted.count(), ok ? 1 : 0);
    }

    void gecosRoundTrip_data()
    {
        QTest::addColumn<QString>("gecos");
        QTest::addColumn<QString>("name");
        QTest::addColumn<QString>("written"); // every non-empty part follows one blank

        QTest::newRow("name and phone") << "John Smith,,555," << "John Smith" << " John Smith,, 555,";
        QTest::newRow("already written") << " John Smith,, 555," << "John Smith" << " John Smith,, 555,";
        QTest::newRow("five parts") << "a,b,c,d,e" << "a" << " a, b, c, d";
        QTest::newRow("empty") << "" << "" << ",,,";
        QTest::newRow("blanks collapsed") << "  John \t Smith ,  12 b ,," << "John Smith" << " John Smith, 12 b,,";
    }

    void gecosRoundTrip()
    {
        QFETCH(QString, gecos);

        GecosDialog dialog;
        dialog.setGecos(QStringLiteral("old,old,old,old")); // must not survive the next user
        dialog.setGecos(gecos);
        QTEST(edit(&dialog, "_nameLineEdit")->text(), "name");
        QTEST(dialog.gecos(), "written");
    }

    void gecosRejectsComma_data()
    {
        QTest::addColumn<QString>("field");
        for (const char *name : {"_nameLineEdit", "_roomLineEdit", "_phoneLineEdit", "_otherLineEdit"})
            QTest::newRow(name) << QString::fromLatin1(name);
    }

    void gecosRejectsComma()
    {
        QFETCH(QString, field);

        GecosDialog dialog;
        QVERIFY(showAndType(&dialog, {{qPrintable(field), QStringLiteral("a,b")}}));
        QCOMPARE(edit(&dialog, qPrintable(field))->text(), QStringLiteral("ab"));
    }

    void screenshots()
    {
        PasswordDialog password;
        PasswordInputDialog input;
        GecosDialog gecos;
        QVERIFY(gecos.findChild<QDialogButtonBox *>(QStringLiteral("buttonBox"))); // callers know it so
        for (QDialog *dialog : std::initializer_list<QDialog *>{&password, &input, &gecos}) {
            QVERIFY(showAndType(dialog));
            QVERIFY(keepScreenshot(dialog, QString::fromLatin1(dialog->metaObject()->className()).toLower()));
        }
    }
};

QTEST_MAIN(CredentialDialogsTest)
#include "tst_credentialdialogs.moc"
