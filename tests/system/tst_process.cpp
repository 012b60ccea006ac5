#include <kvt-common/appexception.h>
#include <kvt-common/package.h>
#include <kvt-common/process.h>

#include "fakeprograms.h"

#include <QElapsedTimer>
#include <QtConcurrent>
#include <QtTest>

#include <csignal>
#include <sys/types.h>

namespace {

// Runs a command and returns the text of the AppException it throws, or a
// null string when it returns normally; \a output receives what it printed.
QString runProcess(const QString &program, const QStringList &arguments, bool checkExitCode,
                   QString *output = nullptr)
{
    Process process;
    try {
        process.simpleStart(program, arguments, checkExitCode);
    } catch (const AppException &e) {
        return e.getText();
    }
    if (output)
        *output = process.output();
    return QString();
}

} // namespace

class ProcessTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void exceptionKeepsTextAndBytes();
    void exceptionWhatAcrossThreads();

    void failures_data();
    void failures();
    void argumentsAreNotExpanded();
    void programFoundOnPath();
    void outputIsCompleteAndDrained();
    void timeoutEndsTheProgram();

    void realPackageDatabase();
    void packageStatus_data();
    void packageStatus();
    void packageQueryArguments();
    void packageQueryFailures_data();
    void packageQueryFailures();
};

void ProcessTest::exceptionKeepsTextAndBytes()
{
    const QString text = QStringLiteral("Ошибка: файл «/etc/x» не найден");
    const char *bytes = nullptr;
    {
        auto *original = new AppException(text);
        bytes = original->what();
        QCOMPARE(QByteArray(bytes), text.toLocal8Bit());
        // Repeated calls hand out the same, still valid, pointer.
        QCOMPARE(original->what(), bytes);

        AppException copy(*original);
        delete original;
        QCOMPARE(copy.getText(), text);
        QCOMPARE(QByteArray(copy.what()), text.toLocal8Bit());

        AppException assigned(QStringLiteral("first"));
        const char *first = assigned.what();
        QCOMPARE(QByteArray(first), QByteArray("first"));
        assigned = copy;
        QCOMPARE(assigned.getText(), text);
        QCOMPARE(QByteArray(assigned.what()), text.toLocal8Bit());
    }

    // Thrown by value, caught as the standard exception: what() still answers.
    try {
        throw AppException(QStringLiteral("plain"));
    } catch (const std::exception &e) {
        QCOMPARE(QByteArray(e.what()), QByteArray("plain"));
    }
    AppException empty;
    QVERIFY(empty.getText().isEmpty());
    QCOMPARE(QByteArray(empty.what()), QByteArray());
}

void ProcessTest::exceptionWhatAcrossThreads()
{
    // Exceptions are made, read and dropped on several threads at once; every
    // reader must see its own message.
    const auto work = [](int seed) {
        int mismatches = 0;
        for (int i = 0; i < 2000; ++i) {
            const QString text = QStringLiteral("m%1-%2").arg(seed).arg(i);
            AppException e(text);
            AppException copy = e;
            if (QByteArray(copy.what()) != text.toLatin1() || QByteArray(e.what()) != text.toLatin1())
                ++mismatches;
        }
        return mismatches;
    };
    QList<QFuture<int>> futures;
    for (int seed = 0; seed < 4; ++seed)
        futures << QtConcurrent::run(work, seed);
    for (QFuture<int> &f : futures)
        QCOMPARE(f.result(), 0);
}

void ProcessTest::failures_data()
{
    QTest::addColumn<QString>("program");
    QTest::addColumn<QStringList>("arguments");
    QTest::addColumn<bool>("checkExitCode");
    QTest::addColumn<QString>("expectedMessage"); // null: no exception
    QTest::addColumn<QString>("expectedOutput");

    const QString sh = QStringLiteral("/bin/sh");
    const auto c = [](const char *script) { return QStringList{QStringLiteral("-c"), QString::fromUtf8(script)}; };
    const auto cmd = [&](const char *script) { return sh + QStringLiteral(" -c ") + QString::fromUtf8(script); };

    QTest::newRow("success") << sh << c("echo hello") << true << QString() << "hello\n";
    QTest::newRow("exit 1 unchecked keeps output")
        << sh << c("echo partial; echo err >&2; exit 1") << false << QString() << "partial\n";
    QTest::newRow("exit 2 with stderr, newline kept")
        << sh << c("echo boom >&2; exit 2") << true
        << QString(QStringLiteral("Process '%1' execute with error code '2'. boom\n").arg(cmd("echo boom >&2; exit 2")))
        << QString();
    QTest::newRow("exit 3 without stderr")
        << sh << c("exit 3") << true
        << QString(QStringLiteral("Process '%1' execute with error code '3'").arg(cmd("exit 3"))) << QString();
    QTest::newRow("stderr is not trimmed")
        << sh << c("printf '  two\\nlines \\n\\n' >&2; exit 9") << true
        << QString(QStringLiteral("Process '%1' execute with error code '9'.   two\nlines \n\n")
                       .arg(cmd("printf '  two\\nlines \\n\\n' >&2; exit 9")))
        << QString();
    QTest::newRow("stderr cut at NUL")
        << sh << c("printf 'ab\\000cd' >&2; exit 4") << true
        << QString(QStringLiteral("Process '%1' execute with error code '4'. ab").arg(cmd("printf 'ab\\000cd' >&2; exit 4")))
        << QString();
    QTest::newRow("stderr starting with NUL counts as empty")
        << sh << c("printf '\\000zz' >&2; exit 5") << true
        << QString(QStringLiteral("Process '%1' execute with error code '5'").arg(cmd("printf '\\000zz' >&2; exit 5")))
        << QString();
    QTest::newRow("stderr with invalid UTF-8")
        << sh << c("printf 'a\\377b' >&2; exit 6") << true
        << QString(QStringLiteral("Process '%1' execute with error code '6'. a") + QChar(0xFFFD) + QStringLiteral("b"))
               .arg(cmd("printf 'a\\377b' >&2; exit 6"))
        << QString();
    QTest::newRow("percent signs in the command are kept")
        << sh << QStringList{QStringLiteral("-c"), QStringLiteral("exit 7"), QStringLiteral("%2"), QStringLiteral("%1")}
        << true << QStringLiteral("Process '/bin/sh -c exit 7 %2 %1' execute with error code '7'") << QString();
    QTest::newRow("missing program")
        << QStringLiteral("/nonexistent/kvt-no-such-program") << QStringList() << true
        << QStringLiteral("Process '/nonexistent/kvt-no-such-program' not finished") << QString();
    QTest::newRow("missing program, unchecked exit code")
        << QStringLiteral("kvt-no-such-program") << QStringList{QStringLiteral("-x")} << false
        << QStringLiteral("Process 'kvt-no-such-program -x' not finished") << QString();
    QTest::newRow("killed by a signal")
        << sh << c("echo dying >&2; kill -SEGV $$") << true
        << QString(QStringLiteral("Process '%1' not finished").arg(cmd("echo dying >&2; kill -SEGV $$"))) << QString();
    QTest::newRow("killed by a signal, unchecked exit code")
        << sh << c("kill -KILL $$") << false
        << QString(QStringLiteral("Process '%1' not finished").arg(cmd("kill -KILL $$"))) << QString();
    QTest::newRow("not executable")
        << QStringLiteral("/etc/hostname") << QStringList() << false
        << QStringLiteral("Process '/etc/hostname' not finished") << QString();
}

void ProcessTest::failures()
{
    QFETCH(QString, program);
    QFETCH(QStringList, arguments);
    QFETCH(bool, checkExitCode);
    QFETCH(QString, expectedMessage);
    QFETCH(QString, expectedOutput);

    QString output;
    const QString message = runProcess(program, arguments, checkExitCode, &output);
    QCOMPARE(message, expectedMessage);
    QCOMPARE(message.isNull(), expectedMessage.isNull());
    if (expectedMessage.isNull())
        QCOMPARE(output, expectedOutput);
}

void ProcessTest::argumentsAreNotExpanded()
{
    // No shell sits between us and the program: blanks, globs, variables,
    // quotes and command substitutions arrive as written.
    const QStringList arguments{QStringLiteral("a  b"), QStringLiteral("$HOME"), QStringLiteral("*"),
                                QStringLiteral("`id`"), QStringLiteral("$(id)"), QStringLiteral("\"q\" 'r'"),
                                QStringLiteral("x;y|z"), QStringLiteral("line\nbreak"), QString()};
    QString output;
    const QString message = runProcess(QStringLiteral("/usr/bin/printf"),
                                       QStringList{QStringLiteral("[%s]")} + arguments, true, &output);
    QVERIFY2(message.isNull(), qPrintable(message));
    QString expected;
    for (const QString &a : arguments)
        expected += QLatin1Char('[') + a + QLatin1Char(']');
    QCOMPARE(output, expected);
}

void ProcessTest::programFoundOnPath()
{
    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    fakes.add(QStringLiteral("x"), "echo boom >&2\nexit 2");
    // The message names the program as given, not the path it was found at,
    // and an empty argument list leaves no trailing blank.
    QCOMPARE(runProcess(QStringLiteral("x"), {}, true),
             QStringLiteral("Process 'x' execute with error code '2'. boom\n"));
    QCOMPARE(runProcess(QStringLiteral("x"), {}, false), QString());
}

void ProcessTest::outputIsCompleteAndDrained()
{
    // More than any pipe buffer holds, on both channels: the wait must keep
    // reading or the program would block for ever.
    Process process;
    process.simpleStart(QStringLiteral("/bin/sh"),
                        {QStringLiteral("-c"),
                         QStringLiteral("head -c 3000000 /dev/zero | tr '\\000' a; "
                                        "head -c 300000 /dev/zero | tr '\\000' e >&2; exit 1")},
                        false);
    const QString output = process.output();
    QCOMPARE(output.size(), 3000000);
    QCOMPARE(output.count(QLatin1Char('a')), 3000000);
    QVERIFY(process.output().isEmpty());

    // Standard output stops at a NUL byte, as every conversion of the library.
    Process nul;
    nul.simpleStart(QStringLiteral("/usr/bin/printf"), {QStringLiteral("one\\000two")}, true);
    QCOMPARE(nul.output(), QStringLiteral("one"));
}

void ProcessTest::timeoutEndsTheProgram()
{
    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    const QString pidFile = fakes.filePath(QStringLiteral("pid"));
    fakes.add(QStringLiteral("hang"), "echo $$ > \"$1\"\nexec sleep 120");

    QElapsedTimer timer;
    timer.start();
    Process process;
    QString message;
    try {
        process.simpleStart(QStringLiteral("hang"), {pidFile}, false);
    } catch (const AppException &e) {
        message = e.getText();
    }
    const qint64 elapsed = timer.elapsed();
    QCOMPARE(message, QStringLiteral("Process 'hang %1' not finished").arg(pidFile));
    QVERIFY2(elapsed >= 29000 && elapsed < 45000, qPrintable(QString::number(elapsed)));

    // The program does not survive the failed call.
    const pid_t pid = fakes.read(QStringLiteral("pid")).trimmed().toInt();
    QVERIFY(pid > 0);
    QCOMPARE(process.state(), QProcess::NotRunning);
    QVERIFY(::kill(pid, 0) != 0);
}

void ProcessTest::realPackageDatabase()
{
    if (QStandardPaths::findExecutable(QStringLiteral("dpkg-query")).isEmpty())
        QSKIP("dpkg-query is not installed on this machine");
    // dpkg itself is always installed where dpkg-query runs.
    QVERIFY(Package(QStringLiteral("dpkg")).isInstalled());
    QVERIFY(Package(QStringLiteral("coreutils")).isInstalled());
    QVERIFY(!Package(QStringLiteral("kvt-no-such-package-4711")).isInstalled());
    // A pattern is expanded by dpkg-query.
    QVERIFY(Package(QStringLiteral("dpk[g]")).isInstalled());
    QCOMPARE(Package(QStringLiteral("dpkg")).name(), QStringLiteral("dpkg"));
}

void ProcessTest::packageStatus_data()
{
    QTest::addColumn<QByteArray>("status");
    QTest::addColumn<bool>("installed");

    QTest::newRow("installed") << QByteArray("install ok installed\n") << true;
    QTest::newRow("unpacked counts") << QByteArray("install ok unpacked\n") << true;
    QTest::newRow("half-configured counts") << QByteArray("install ok half-configured\n") << true;
    QTest::newRow("config files only") << QByteArray("deinstall ok config-files\n") << false;
    QTest::newRow("not installed") << QByteArray("unknown ok not-installed\n") << false;
    QTest::newRow("held") << QByteArray("hold ok installed\n") << false;
    QTest::newRow("error flag") << QByteArray("install reinstreq half-installed\n") << false;
    QTest::newRow("leading blank is no match") << QByteArray(" install ok installed\n") << false;
    QTest::newRow("several lines, match later")
        << QByteArray("deinstall ok config-files\npurge ok not-installed\ninstall ok installed\n") << true;
    QTest::newRow("several lines, none") << QByteArray("deinstall ok config-files\n\n\npurge ok not-installed") << false;
    QTest::newRow("no newline at end") << QByteArray("install ok installed") << true;
    QTest::newRow("empty") << QByteArray() << false;
}

void ProcessTest::packageStatus()
{
    QFETCH(QByteArray, status);
    QFETCH(bool, installed);

    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    // The fake prints the raw status kept in a data file beside it.
    QFile data(fakes.filePath(QStringLiteral("status")));
    QVERIFY(data.open(QIODevice::WriteOnly | QIODevice::Truncate));
    data.write(status);
    data.close();
    fakes.add(QStringLiteral("dpkg-query"), "cat \"$(dirname \"$0\")/status\"");

    QCOMPARE(Package(QStringLiteral("some-package")).isInstalled(), installed);
}

void ProcessTest::packageQueryArguments()
{
    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    // Each argument on its own, framed, so that the embedded newline shows.
    fakes.add(QStringLiteral("dpkg-query"),
              "for a in \"$@\"; do printf '<%s>' \"$a\"; done > \"$(dirname \"$0\")/args\"\n"
              "echo 'install ok installed'\nexit 1");
    QVERIFY(Package(QStringLiteral("postgresql-[0123456789]*")).isInstalled());
    QCOMPARE(fakes.read(QStringLiteral("args")), QByteArray("<-W><-f=${Status}\n><postgresql-[0123456789]*>"));
}

void ProcessTest::packageQueryFailures_data()
{
    QTest::addColumn<QByteArray>("script"); // null: no dpkg-query at all
    QTest::addColumn<QString>("expectedMessage");

    const QString command = QStringLiteral("dpkg-query -W -f=${Status}\n some-package");
    QTest::newRow("dpkg-query missing") << QByteArray() << QStringLiteral("Process '%1' not finished").arg(command);
    QTest::newRow("dpkg-query crashes")
        << QByteArray("echo 'install ok installed'\nkill -ABRT $$") << QStringLiteral("Process '%1' not finished").arg(command);
    QTest::newRow("non-zero exit is not an error")
        << QByteArray("echo 'dpkg-query: no packages found' >&2\nexit 1") << QString();
}

void ProcessTest::packageQueryFailures()
{
    QFETCH(QByteArray, script);
    QFETCH(QString, expectedMessage);

    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    if (script.isNull())
        fakes.useOnlyFakes();
    else
        fakes.add(QStringLiteral("dpkg-query"), script);

    QString message;
    bool installed = true;
    try {
        installed = Package(QStringLiteral("some-package")).isInstalled();
    } catch (const AppException &e) {
        message = e.getText();
    }
    QCOMPARE(message, expectedMessage);
    if (expectedMessage.isNull())
        QVERIFY(!installed);
}

QTEST_GUILESS_MAIN(ProcessTest)
#include "tst_process.moc"
