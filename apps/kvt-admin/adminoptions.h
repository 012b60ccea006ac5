// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#ifndef KVT_ADMIN_ADMINOPTIONS_H
#define KVT_ADMIN_ADMINOPTIONS_H

#include <QCoreApplication>
#include <QStringList>

class QCommandLineParser;

//! What the command line asks of kvt-admin.
struct AdminOptions
{
    Q_DECLARE_TR_FUNCTIONS(AdminOptions)

public:
    //! How long --list waits for the initial reads, in seconds.
    static const int listWaitSeconds = 60;
    //! How long the tool waits at exit for running tasks, in seconds.
    static const int exitWaitSeconds = 70;

    QStringList pluginDirectories;
    bool list = false;
    QString screenshot;
    bool allowChanges = false;
    int workers = 2;

    //! Adds the options of the tool, --help and --version to \a parser.
    static void addOptions(QCommandLineParser &parser);
    /*!
     * Reads the options of a parser that has processed the command line.
     * False with a message in \a error for a value that makes no sense.
     */
    static bool read(const QCommandLineParser &parser, AdminOptions &options, QString &error);
    /*!
     * The plugin folders used without --plugins: the build tree's when the
     * program runs from the build tree, else the installed one; then every
     * folder of KVT_ADMIN_PLUGIN_PATH (separated by ":").
     */
    static QStringList defaultPluginDirectories();
    //! Where the tool's translations are looked for, in order.
    static QStringList translationDirectories();
};

#endif
