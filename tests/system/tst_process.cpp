// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/package.h>
#include <kvt-common/process.h>

#include "systemtest.h"

#include <QElapsedTimer>
#include <QtConcurrent>
#include <QtTest>

#include <csignal>

class ProcessTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void exceptionText()
    {
        // The bytes of what() belong to each object: an assignment renews them, a
        // copy outlives its original, and threads working at once never mix them.
        const auto work = [](int seed) {
            int mismatches = 0;
            for (int i = 0; i < 2000; ++i) {
                const QString text = QStringLiteral("Ошибка «%1-%2»").arg(seed).arg(i);
                AppException assigned(QStringLiteral("first"));
                auto *original = new AppException(text);
                mismatches += qstrcmp(assigned.what(), "first") != 0 || original->what() != text.toLocal8Bit();
                assigned = *original;
                const AppException copy(*original);
                delete original;
                const std::exception &base = copy;
                mismatches += assigned.what() != text.toLocal8Bit() || base.what() != text.toLocal8Bit();
            }
            return mismatches;
        };
        QList<QFuture<int>> futures;
        for (int seed = 0; seed < 4; ++seed)
            futures << QtConcurrent::run(work, seed);
        for (QFuture<int> &f : futures)
            QCOMPARE(f.result(), 0);
    }

    void simpleStart_data()
    {
        QTest::addColumn<QString>("program");
        QTest::addColumn<QStringList>("arguments");
        QTest::addColumn<bool>("checkExitCode");
        QTest::addColumn<QString>("result"); // the exception's text, else "output:" and the output

        const QString sh = QStringLiteral("/bin/sh");
        const auto c = [](const QString &script) { return QStringList{QStringLiteral("-c"), script}; };
        const auto exited = [](const QString &script, int code) {
            return QStringLiteral("Process '/bin/sh -c %1' execute with error code '%2'").arg(script).arg(code);
        };

        QTest::newRow("exit 1 unchecked keeps output")
            << sh << c("echo partial; echo err >&2; exit 1") << false << "output:partial\n";
        QTest::newRow("arguments are not expanded")
            << "/usr/bin/printf" << QStringList{"[%s]", "a  b", "$HOME", "*", "$(id)", "'r'", "x;y", "line\nbreak", ""}
            << true << "output:[a  b][$HOME][*][$(id)]['r'][x;y][line\nbreak][]";
        // More than any pipe buffer holds, on both channels: the wait must keep reading.
        QTest::newRow("large output") << sh << c("head -c 300000 /dev/zero | tr '\\000' a; head -c 300000 /dev/zero >&2")
                                      << true << "output:" + QString(300000, QLatin1Char('a'));
        QTest::newRow("no stderr, no separator, percent signs kept") << sh << QStringList{"-c", "exit 3", "%2", "%1"} << true
            << "Process '/bin/sh -c exit 3 %2 %1' execute with error code '3'";
        QTest::newRow("stderr appended untrimmed, cut at NUL")
            << sh << c("printf '  two\\nlines \\n\\000cd' >&2; exit 4") << true
            << exited("printf '  two\\nlines \\n\\000cd' >&2; exit 4", 4) + ".   two\nlines \n";
        QTest::newRow("time-out, unchecked exit code") << "hang" << QStringList() << false << "Process 'hang' not finished";
        QTest::newRow("crash, unchecked exit code")
            << sh << c("echo dying >&2; kill -SEGV $$") << false
            << "Process '/bin/sh -c echo dying >&2; kill -SEGV $$' not finished";
    }

    void simpleStart()
    {
        QFETCH(QString, program);
        QFETCH(QStringList, arguments);
        QFETCH(bool, checkExitCode);
        QFETCH(QString, result);

        FakePrograms fakes;
        fakes.add(QStringLiteral("hang"), "echo $$ > \"$(dirname \"$0\")/pid\"\nexec sleep 120");
        QElapsedTimer timer;
        timer.start();
        Process process;
        QString message = thrown([&] { process.simpleStart(program, arguments, checkExitCode); });
        QCOMPARE(message.isNull() ? QStringLiteral("output:") + process.output() : message, result);
        // A program that does not end within 30 seconds is stopped and does not survive the call.
        if (const pid_t pid = readFile(fakes.filePath(QStringLiteral("pid"))).trimmed().toInt()) {
            QVERIFY2(timer.elapsed() >= 29000 && timer.elapsed() < 45000, qPrintable(QString::number(timer.elapsed())));
            QVERIFY(::kill(pid, 0) != 0);
        }
    }

    void packageInstalled_data()
    {
        QTest::addColumn<QByteArray>("script");
        QTest::addColumn<bool>("installed");
        QTest::addColumn<QString>("message");

        // Any state after "install ok" counts.
        QTest::newRow("unpacked, on a later line, no final newline")
            << QByteArray("printf 'purge ok not-installed\\n\\ninstall ok unpacked'") << true << QString();
        QTest::newRow("config files only, non-zero exit is not an error")
            << QByteArray("echo 'deinstall ok config-files'; exit 1") << false << QString();
        QTest::newRow("dpkg-query crashes") << QByteArray("echo 'install ok installed'; kill -ABRT $$") << false
                                            << "Process 'dpkg-query -W -f=${Status}\n some-package' not finished";
    }

    void packageInstalled()
    {
        QFETCH(QByteArray, script);
        QFETCH(bool, installed);
        QFETCH(QString, message);

        FakePrograms fakes; // each argument framed on its own, so that the embedded newline shows
        fakes.add(QStringLiteral("dpkg-query"), "for a; do printf '<%s>' \"$a\"; done > \"$(dirname \"$0\")/args\"\n" + script);

        bool answer = false;
        QCOMPARE(thrown([&] { answer = Package(QStringLiteral("some-package")).isInstalled(); }), message);
        QCOMPARE(answer, installed);
        QCOMPARE(readFile(fakes.filePath(QStringLiteral("args"))), QByteArray("<-W><-f=${Status}\n><some-package>"));
    }

    void realPackageDatabase()
    {
        if (QStandardPaths::findExecutable(QStringLiteral("dpkg-query")).isEmpty())
            QSKIP("dpkg-query is not installed on this machine");
        QVERIFY(Package(QStringLiteral("dpkg")).isInstalled());
        QVERIFY(Package(QStringLiteral("dpk[g]")).isInstalled()); // dpkg-query expands the pattern
        QVERIFY(!Package(QStringLiteral("kvt-no-such-package-4711")).isInstalled());
    }
};

QTEST_GUILESS_MAIN(ProcessTest)
#include "tst_process.moc"
