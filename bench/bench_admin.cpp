// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// kvt-admin as a user meets it.
//
// - Selection round trip: a key is chosen in the main window's element view,
//   its read task runs on a worker, its widget is filled; 1,000 selections
//   in one process, each timed, median reported. Floor: the same read of
//   the same file done directly in this thread.
// - Start-up: `kvt-admin --list` over a sandbox of copied /etc files and
//   over a file of 5,000 keys, as a process. Floor: a bare program doing the
//   same reads (bench_admin_floor).
#include "conffileformat.h"
#include "mainwindow.h"
#include "workerthreads.h"

#include <kvt-common/elementtreeview.h>
#include <kvt-common/elementwidgetcontainer2.h>
#include <kvt-common/vieweditelementwidget.h>

#include <QApplication>
#include <QDir>
#include <QElapsedTimer>
#include <QFile>
#include <QLineEdit>
#include <QProcess>
#include <QSettings>
#include <QTemporaryDir>

#include <benchmark/benchmark.h>

#include <algorithm>
#include <chrono>
#include <memory>
#include <vector>

namespace {

QTemporaryDir *sandbox()
{
    static QTemporaryDir dir;
    return &dir;
}

QString writeKeys(const QString &name, int count)
{
    const QString path = sandbox()->filePath(name);
    QFile file(path);
    file.open(QIODevice::WriteOnly | QIODevice::Truncate);
    file.write("# generated for the benchmark\n");
    for (int i = 0; i < count; ++i)
        file.write(QStringLiteral("KEY_%1 = value %1  # comment %1\n").arg(i, 5, 10, QLatin1Char('0')).toUtf8());
    return path;
}

// Copies of the files `make demo` uses, as far as this machine has them.
QStringList demoFiles()
{
    QStringList files;
    for (const char *name : {"login.defs", "adduser.conf", "deluser.conf", "host.conf"}) {
        const QString source = QStringLiteral("/etc/") + QLatin1String(name);
        const QString copy = sandbox()->filePath(QLatin1String(name));
        if (QFile::exists(source) && (QFile::exists(copy) || QFile::copy(source, copy)))
            files << copy;
    }
    if (files.isEmpty())
        files << writeKeys(QStringLiteral("demo.conf"), 40);
    return files;
}

// Settings of a home of its own, read by the plugin here and by the
// processes started below.
void manage(const QStringList &files)
{
    QSettings settings;
    settings.setValue(QStringLiteral("conffiles/files"), files);
    settings.sync();
}

void report(benchmark::State &state, std::vector<double> &ms)
{
    if (ms.empty())
        return;
    std::sort(ms.begin(), ms.end());
    state.counters["median_ms"] = ms[ms.size() / 2];
    state.counters["p90_ms"] = ms[ms.size() * 9 / 10];
}

void BM_SelectionRoundTrip(benchmark::State &state)
{
    const QString path = writeKeys(QStringLiteral("keys50.conf"), 50);
    manage({path});
    MainWindow window;
    window.show();
    window.loadPlugins({QStringLiteral(KVT_ADMIN_PLUGIN_DIR)});
    window.readAllElements(30000);
    QAbstractItemModel *model = window.elementView()->model();
    const QModelIndex file = model->index(0, 0);
    QItemSelectionModel *selection = window.elementView()->selectionModel();
    std::vector<double> ms;
    int row = 0;
    for (auto _ : state) {
        row = (row + 7) % model->rowCount(file);
        const QModelIndex key = model->index(row, 0, file);
        const QString expected = QStringLiteral("value %1").arg(row, 5, 10, QLatin1Char('0'));
        QElapsedTimer timer;
        timer.start();
        selection->setCurrentIndex(key, QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
        QLineEdit *value = nullptr;
        for (;;) {
            QCoreApplication::processEvents(QEventLoop::AllEvents);
            ViewEditElementWidget *widget = window.shownEditWidget();
            if (!value && widget)
                value = widget->findChild<QLineEdit *>(QStringLiteral("_valueLineEdit"));
            if (value && widget->element() && !widget->isEditBlocked() && value->text() == expected
                && MainWindow::tasksIdle())
                break;
        }
        const double elapsed = timer.nsecsElapsed() / 1e6;
        ms.push_back(elapsed);
        state.SetIterationTime(elapsed / 1000.0);
    }
    report(state, ms);
    MainWindow::waitForTasks(30000);
}

void BM_SelectionRoundTripFloor(benchmark::State &state)
{
    const QString path = writeKeys(QStringLiteral("keys50.conf"), 50);
    std::vector<double> ms;
    int row = 0;
    for (auto _ : state) {
        row = (row + 7) % 50;
        QElapsedTimer timer;
        timer.start();
        ConfFileScan scan;
        QString error;
        ConfFileFormat::scan(path, scan, error);
        const QString key = QStringLiteral("KEY_%1").arg(row, 5, 10, QLatin1Char('0'));
        benchmark::DoNotOptimize(ConfFileFormat::find(scan, key, 0));
        const double elapsed = timer.nsecsElapsed() / 1e6;
        ms.push_back(elapsed);
        state.SetIterationTime(elapsed / 1000.0);
    }
    report(state, ms);
}

void runProcess(benchmark::State &state, const QString &program, const QStringList &arguments)
{
    std::vector<double> ms;
    for (auto _ : state) {
        QElapsedTimer timer;
        timer.start();
        QProcess process;
        process.start(program, arguments);
        process.waitForFinished(120000);
        benchmark::DoNotOptimize(process.readAllStandardOutput());
        const double elapsed = timer.nsecsElapsed() / 1e6;
        if (process.exitCode() != 0) {
            state.SkipWithError("the program failed");
            break;
        }
        ms.push_back(elapsed);
        state.SetIterationTime(elapsed / 1000.0);
    }
    report(state, ms);
}

QStringList startupFiles(int which)
{
    return which == 0 ? demoFiles() : QStringList{writeKeys(QStringLiteral("keys5000.conf"), 5000)};
}

void BM_ListStartup(benchmark::State &state)
{
    const QStringList files = startupFiles(int(state.range(0)));
    manage(files);
    runProcess(state, QStringLiteral(KVT_ADMIN_EXECUTABLE),
               {QStringLiteral("--list"), QStringLiteral("--plugins"), QStringLiteral(KVT_ADMIN_PLUGIN_DIR)});
}

void BM_ListStartupFloor(benchmark::State &state)
{
    runProcess(state, QStringLiteral(KVT_ADMIN_FLOOR_EXECUTABLE), startupFiles(int(state.range(0))));
}

} // namespace

BENCHMARK(BM_SelectionRoundTrip)->Iterations(1000)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(BM_SelectionRoundTripFloor)->Iterations(1000)->UseManualTime()->Unit(benchmark::kMillisecond);
// Argument 0: the demo sandbox; 1: one file of 5,000 keys.
BENCHMARK(BM_ListStartup)->Arg(0)->Arg(1)->Iterations(15)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(BM_ListStartupFloor)->Arg(0)->Arg(1)->Iterations(15)->UseManualTime()->Unit(benchmark::kMillisecond);

int main(int argc, char **argv)
{
    // A home of its own: the settings written here are the ones the tool
    // started below reads, and the user's are never touched.
    QTemporaryDir home;
    qputenv("HOME", home.path().toLocal8Bit());
    qputenv("XDG_CONFIG_HOME", QDir(home.path()).filePath(QStringLiteral("config")).toLocal8Bit());
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication app(argc, argv);
    QCoreApplication::setOrganizationName(QStringLiteral("kvt-admin"));
    QCoreApplication::setApplicationName(QStringLiteral("kvt-admin"));
    WorkerThreads workers(2);

    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    MainWindow::waitForTasks(30000);
    workers.stop();
    return 0;
}
