// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Loading a plugin directory: PluginContainer::loadPlugins (unload what is
// loaded, walk the directory, load and check every file, collect and hang
// the modules, announce one reset) beside the bare QPluginLoader work on the
// same files (unload the previous set, load, instance). Both create and
// destroy the same plugin objects and modules, so the ratio is what the
// container adds.
#include <kvt-common/plugincontainer.h>

#include <QApplication>
#include <QDirIterator>
#include <QPluginLoader>
#include <QTemporaryDir>

#include <benchmark/benchmark.h>

#include <memory>
#include <vector>

namespace {

const QString pluginDir = QStringLiteral(KVT_BENCH_PLUGIN_DIR);

QStringList pluginFiles()
{
    QStringList files;
    QDirIterator it(pluginDir, QStringList{QStringLiteral("*.so")}, QDir::Files,
                    QDirIterator::Subdirectories);
    while (it.hasNext())
        files.append(QFileInfo(it.next()).absoluteFilePath());
    return files;
}

void BM_PluginContainerLoad(benchmark::State &state)
{
    PluginContainer container;
    for (auto _ : state)
        container.loadPlugins(pluginDir);
    state.counters["plugins"] = container.plugins().size();
    state.counters["modules"] = container.modules().size();
    container.unloadPlugins();
}

void BM_QPluginLoaderLoop(benchmark::State &state)
{
    const QStringList files = pluginFiles();
    std::vector<std::unique_ptr<QPluginLoader>> loaders;
    int instances = 0;
    for (auto _ : state) {
        for (auto &loader : loaders)
            loader->unload();
        loaders.clear();
        instances = 0;
        for (const QString &file : files) {
            loaders.emplace_back(new QPluginLoader(file));
            QPluginLoader &loader = *loaders.back();
            // The container's hints, so both keep the objects mapped alike.
            loader.setLoadHints(QLibrary::ResolveAllSymbolsHint | QLibrary::PreventUnloadHint);
            if (loader.load() && loader.instance())
                ++instances;
        }
    }
    state.counters["plugins"] = instances;
    for (auto &loader : loaders)
        loader->unload();
}

BENCHMARK(BM_PluginContainerLoad)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_QPluginLoaderLoop)->Unit(benchmark::kMillisecond);

} // namespace

int main(int argc, char **argv)
{
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");
    // Modules read their settings when made: from a folder of the run's own.
    QTemporaryDir home;
    qputenv("XDG_CONFIG_HOME", home.path().toLocal8Bit());
    QApplication app(argc, argv);
    QCoreApplication::setOrganizationName(QStringLiteral("kvt-bench"));
    QCoreApplication::setApplicationName(QStringLiteral("bench_plugin"));

    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
