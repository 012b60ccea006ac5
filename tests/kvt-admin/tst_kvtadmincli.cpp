// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// kvt-admin run as a process: the inspector (--list), the screenshot, the
// command-line errors; judged by output and exit code.

#include "admintest.h"

#include <QDir>
#include <QFile>
#include <QImage>
#include <QProcess>
#include <QTest>

using namespace AdminTest;

class TestKvtAdminCli : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void commandLine_data();
    void commandLine();
    void screenshot();

private:
    struct Run
    {
        int exitCode = -1;
        QString out;
        QString err;
    };
    Run run(const QStringList &arguments, int timeoutMs = 90000);

    std::unique_ptr<Sandbox> _sandbox;
    std::unique_ptr<Sandbox> _plugins;
    std::unique_ptr<Sandbox> _conffilesOnly; // the output does not depend on the other plugins
};

void TestKvtAdminCli::initTestCase()
{
    // The settings the program reads are those of this test's home.
    QCoreApplication::setOrganizationName(QStringLiteral("kvt-admin"));
    QCoreApplication::setApplicationName(QStringLiteral("kvt-admin"));
    _sandbox = std::make_unique<Sandbox>();
    _sandbox->write(QStringLiteral("sample.conf"), "# settings\nNAME = value  # why\nOTHER yes\n");
    _sandbox->manage({QStringLiteral("sample.conf"), QStringLiteral("missing.conf")});

    _plugins = std::make_unique<Sandbox>();
    QVERIFY(QFile::link(QStringLiteral(KVT_ADMIN_PLUGIN_DIR "/conffiles.so"), _plugins->path(QStringLiteral("conffiles.so"))));
    _plugins->write(QStringLiteral("broken.so"), "not a shared object\n");

    _conffilesOnly = std::make_unique<Sandbox>();
    QVERIFY(QFile::link(QStringLiteral(KVT_ADMIN_PLUGIN_DIR "/conffiles.so"),
                        _conffilesOnly->path(QStringLiteral("conffiles.so"))));
}

TestKvtAdminCli::Run TestKvtAdminCli::run(const QStringList &arguments, int timeoutMs)
{
    QProcess process;
    process.start(QStringLiteral(KVT_ADMIN_EXECUTABLE), arguments);
    Run result;
    if (!process.waitForFinished(timeoutMs)) {
        process.kill();
        process.waitForFinished();
        result.err = QStringLiteral("timed out");
        return result;
    }
    result.exitCode = process.exitStatus() == QProcess::NormalExit ? process.exitCode() : -2;
    result.out = QString::fromUtf8(process.readAllStandardOutput());
    result.err = QString::fromUtf8(process.readAllStandardError());
    return result;
}

void TestKvtAdminCli::commandLine_data()
{
    QTest::addColumn<QStringList>("arguments");
    QTest::addColumn<int>("exitCode");
    QTest::addColumn<QStringList>("out");
    QTest::addColumn<QStringList>("err");

    const QString plugins = QStringLiteral(KVT_ADMIN_PLUGIN_DIR);
    QTest::newRow("list")
        << QStringList{"--list", "--plugins", _conffilesOnly->path(QString())} << 0
        << QStringList{"Plugin files:\n  accepted " + plugins + "/conffiles.so: Configuration files",
                       "Modules:\n  conffiles  [Reread: off; ",
                       "Elements:\n  missing.conf\n  sample.conf\n    NAME = value\n    OTHER = yes\n",
                       "Problems:\n  fail Read \"",
                       "missing.conf\" not exists"}
        << QStringList();
    QTest::newRow("refused file and a second folder")
        << QStringList{"--list", "--plugins", _plugins->path(QString()), "--plugins", plugins} << 0
        << QStringList{"broken.so: ", "  refused  " + _plugins->path(QStringLiteral("broken.so")) + ": ",
                       "  accepted " + plugins + "/conffiles.so", "    NAME = value\n"}
        << QStringList();
    QTest::newRow("missing plugin folder")
        << QStringList{"--list", "--plugins", "/nonexistent/plugins"} << 1 << QStringList()
        << QStringList{"plugin folder \"/nonexistent/plugins\" does not exist"};
    QTest::newRow("workers out of range")
        << QStringList{"--list", "--workers", "0"} << 2 << QStringList()
        << QStringList{"--workers takes a number from 1 to 64, not \"0\""};
    QTest::newRow("help") << QStringList{"--help"} << 0
                          << QStringList{"--plugins <dir>", "--list", "--screenshot <file>", "--allow-changes",
                                         "--workers <n>"}
                          << QStringList();
    QTest::newRow("version") << QStringList{"--version"} << 0 << QStringList{"kvt-admin "} << QStringList();
}

void TestKvtAdminCli::commandLine()
{
    QFETCH(QStringList, arguments);
    QFETCH(int, exitCode);
    QFETCH(QStringList, out);
    QFETCH(QStringList, err);

    const Run result = run(arguments);
    QVERIFY2(result.exitCode == exitCode, qPrintable(QStringLiteral("exit %1\n%2\n%3").arg(result.exitCode).arg(result.out, result.err)));
    for (const QString &text : out)
        QVERIFY2(result.out.contains(text), qPrintable(text + QStringLiteral("\nnot in\n") + result.out));
    for (const QString &text : err)
        QVERIFY2(result.err.contains(text), qPrintable(text + QStringLiteral("\nnot in\n") + result.err));
}

void TestKvtAdminCli::screenshot()
{
    const QString file = _sandbox->path(QStringLiteral("window.png"));
    const Run result = run({QStringLiteral("--screenshot"), file, QStringLiteral("--plugins"),
                            QStringLiteral(KVT_ADMIN_PLUGIN_DIR)});
    QVERIFY2(result.exitCode == 0, qPrintable(result.err));
    QImage image(file);
    QVERIFY(!image.isNull());
    QVERIFY(image.width() >= 600 && image.height() >= 300);
    // Something is drawn: not a single colour.
    const QImage small = image.scaled(32, 32);
    QSet<QRgb> colours;
    for (int y = 0; y < small.height(); ++y)
        for (int x = 0; x < small.width(); ++x)
            colours.insert(small.pixel(x, y));
    QVERIFY(colours.size() > 4);
    QDir().mkpath(QStringLiteral(KVT_ADMIN_SCREENSHOT_DIR));
    QFile::remove(QStringLiteral(KVT_ADMIN_SCREENSHOT_DIR "/kvt-admin-window.png"));
    QFile::copy(file, QStringLiteral(KVT_ADMIN_SCREENSHOT_DIR "/kvt-admin-window.png"));

    const Run unwritable = run({QStringLiteral("--screenshot"), QStringLiteral("/nonexistent/dir/window.png"),
                                QStringLiteral("--plugins"), QStringLiteral(KVT_ADMIN_PLUGIN_DIR)});
    QCOMPARE(unwritable.exitCode, 1);
    QVERIFY(unwritable.err.contains(QStringLiteral("cannot write /nonexistent/dir/window.png")));
}

QTEST_MAIN(TestKvtAdminCli)
#include "tst_kvtadmincli.moc"
