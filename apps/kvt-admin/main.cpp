// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// kvt-admin: administers this computer through plugins.

#include "adminoptions.h"
#include "inventory.h"
#include "mainwindow.h"
#include "workerthreads.h"

#include <QApplication>
#include <QCommandLineParser>
#include <QLibraryInfo>
#include <QLocale>
#include <QMessageBox>
#include <QTextStream>
#include <QTranslator>

#include <cstring>

namespace {

bool hasArgument(int argc, char **argv, const char *name)
{
    const size_t length = std::strlen(name);
    for (int i = 1; i < argc; ++i) {
        if (std::strncmp(argv[i], name, length) == 0 && (argv[i][length] == '\0' || argv[i][length] == '='))
            return true;
    }
    return false;
}

void installTranslator(QCoreApplication &app)
{
    auto *translator = new QTranslator(&app);
    for (const QString &dir : AdminOptions::translationDirectories()) {
        if (translator->load(QLocale(), QStringLiteral("kvt-admin"), QStringLiteral("_"), dir)) {
            QCoreApplication::installTranslator(translator);
            return;
        }
    }
    delete translator;
}

} // namespace

int main(int argc, char **argv)
{
    // The inspector needs no display; a screenshot without one is rendered
    // offscreen. An explicit platform choice is kept.
    const bool noDisplay = qEnvironmentVariableIsEmpty("DISPLAY") && qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY");
    if (qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM")
        && (hasArgument(argc, argv, "--list") || (noDisplay && hasArgument(argc, argv, "--screenshot"))))
        qputenv("QT_QPA_PLATFORM", "offscreen");

    QApplication app(argc, argv);
    QApplication::setOrganizationName(QStringLiteral("kvt-admin"));
    QApplication::setApplicationName(QStringLiteral("kvt-admin"));
    QApplication::setApplicationVersion(QStringLiteral(KVT_ADMIN_VERSION));
    installTranslator(app);

    QCommandLineParser parser;
    AdminOptions::addOptions(parser);
    parser.process(app);

    QTextStream out(stdout);
    QTextStream err(stderr);
    AdminOptions options;
    QString error;
    if (!AdminOptions::read(parser, options, error)) {
        err << "kvt-admin: " << error << '\n';
        return 2;
    }
    const bool headless = options.list || !options.screenshot.isEmpty();

    // Plugins read this before they decide whether they may change the system.
    app.setProperty("kvtAdminAllowChanges", options.allowChanges);

    WorkerThreads workers(options.workers);
    int result = 0;
    {
        MainWindow window;
        window.loadPlugins(options.pluginDirectories);
        const QStringList missing = window.missingDirectories();
        for (const QString &dir : missing)
            err << QObject::tr("kvt-admin: plugin folder \"%1\" does not exist").arg(dir) << '\n';
        err.flush();

        if (headless && !missing.isEmpty()) {
            result = 1;
        } else if (options.list) {
            result = Inventory::print(window, out, err, AdminOptions::listWaitSeconds * 1000);
        } else if (!options.screenshot.isEmpty()) {
            window.show();
            MainWindow::waitForTasks(AdminOptions::listWaitSeconds * 1000);
            QApplication::processEvents();
            if (window.grab().save(options.screenshot, "PNG")) {
                err << QObject::tr("kvt-admin: window rendered to %1").arg(options.screenshot) << '\n';
            } else {
                err << QObject::tr("kvt-admin: cannot write %1").arg(options.screenshot) << '\n';
                result = 1;
            }
        } else {
            window.show();
            if (!missing.isEmpty())
                QMessageBox::warning(&window, QObject::tr("Plugins"),
                                     QObject::tr("These plugin folders do not exist:\n%1").arg(missing.join(QLatin1Char('\n'))));
            result = app.exec();
        }
        // Tasks finish (or time out) while their elements exist; then the
        // workers stop and the completions still pending are delivered.
        if (!MainWindow::waitForTasks(AdminOptions::exitWaitSeconds * 1000))
            err << QObject::tr("kvt-admin: tasks still running at exit; waiting for them to stop") << '\n';
        err.flush();
        workers.stop();
    }
    return result;
}
