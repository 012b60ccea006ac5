// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#include "adminoptions.h"

#include <kvt-common/thread.h>

#include <QCommandLineParser>
#include <QDir>
#include <QFileInfo>

namespace {

const char pluginsOption[] = "plugins";
const char listOption[] = "list";
const char screenshotOption[] = "screenshot";
const char allowChangesOption[] = "allow-changes";
const char workersOption[] = "workers";

bool runsFromBuildTree()
{
    const QString here = QFileInfo(QCoreApplication::applicationDirPath()).canonicalFilePath();
    return !here.isEmpty() && here == QFileInfo(QStringLiteral(KVT_ADMIN_BUILD_BIN_DIR)).canonicalFilePath();
}

} // namespace

void AdminOptions::addOptions(QCommandLineParser &parser)
{
    parser.setApplicationDescription(tr("Administers this computer through plugins."));
    parser.addHelpOption();
    parser.addVersionOption();
    parser.addOption({QString::fromLatin1(pluginsOption),
                      tr("Loads the plugins below <dir> (may be given more than once). Default: %1, "
                         "and the folders of KVT_ADMIN_PLUGIN_PATH.")
                          .arg(QStringLiteral(KVT_ADMIN_PLUGIN_INSTALL_DIR)),
                      tr("dir")});
    parser.addOption({QString::fromLatin1(listOption),
                      tr("Prints the plugin files tried, the module tree and the element tree once every "
                         "container has been read (waiting at most %1 seconds), then exits.")
                          .arg(listWaitSeconds)});
    parser.addOption({QString::fromLatin1(screenshotOption),
                      tr("Renders the main window after start-up to the PNG <file>, then exits."),
                      tr("file")});
    parser.addOption({QString::fromLatin1(allowChangesOption),
                      tr("Lets plugins that change the system (services, accounts) make changes; without "
                         "it they only show.")});
    parser.addOption({QString::fromLatin1(workersOption),
                      tr("Runs tasks on <n> worker threads (1 to %1, default 2).").arg(Thread::BufferSize),
                      tr("n"), QStringLiteral("2")});
}

bool AdminOptions::read(const QCommandLineParser &parser, AdminOptions &options, QString &error)
{
    options.pluginDirectories = parser.values(QString::fromLatin1(pluginsOption));
    if (options.pluginDirectories.isEmpty())
        options.pluginDirectories = defaultPluginDirectories();
    options.list = parser.isSet(QString::fromLatin1(listOption));
    options.screenshot = parser.value(QString::fromLatin1(screenshotOption));
    if (parser.isSet(QString::fromLatin1(screenshotOption)) && options.screenshot.isEmpty()) {
        error = tr("--screenshot needs a file name.");
        return false;
    }
    options.allowChanges = parser.isSet(QString::fromLatin1(allowChangesOption));
    bool ok = false;
    options.workers = parser.value(QString::fromLatin1(workersOption)).toInt(&ok);
    if (!ok || options.workers < 1 || options.workers > Thread::BufferSize) {
        error = tr("--workers takes a number from 1 to %1, not \"%2\".")
                    .arg(Thread::BufferSize)
                    .arg(parser.value(QString::fromLatin1(workersOption)));
        return false;
    }
    return true;
}

QStringList AdminOptions::defaultPluginDirectories()
{
    QStringList directories;
    directories << QString::fromLatin1(runsFromBuildTree() ? KVT_ADMIN_PLUGIN_BUILD_DIR : KVT_ADMIN_PLUGIN_INSTALL_DIR);
    const QString extra = qEnvironmentVariable("KVT_ADMIN_PLUGIN_PATH");
    for (const QString &dir : extra.split(QLatin1Char(':'))) {
        if (!dir.isEmpty())
            directories << dir;
    }
    directories.removeDuplicates();
    return directories;
}

QStringList AdminOptions::translationDirectories()
{
    QStringList directories;
    if (runsFromBuildTree())
        directories << QStringLiteral(KVT_ADMIN_TRANSLATIONS_BUILD_DIR);
    directories << QStringLiteral(KVT_ADMIN_TRANSLATIONS_INSTALL_DIR)
                << QDir(QCoreApplication::applicationDirPath()).filePath(QStringLiteral("../share/kvt-admin/translations"));
    return directories;
}
