// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PROCESS_H
#define KVT_PROCESS_H

#include "kvtcommon_export.h"

#include <QProcess>
#include <QString>
#include <QStringList>

/*!
 * Runs one external program to completion and turns every failure into an
 * AppException.
 *
 * Use one object per command: construct, simpleStart(), output(), destroy.
 * The program is started directly, never through a shell, so arguments are
 * passed exactly as given.
 */
class KVTCOMMON_EXPORT Process : public QProcess
{
    Q_OBJECT

public:
    //! Creates the process object; nothing runs yet.
    explicit Process(QObject *parent = nullptr);
    ~Process() override;

    /*!
     * Starts \a program with \a arguments and blocks until it ends, for at most
     * 30 seconds. Throws AppException when the program cannot be started, does
     * not end in time or crashes, and, when \a checkExitCode is true, when it
     * exits with a code other than 0 (the message then carries its standard
     * error).
     */
    void simpleStart(const QString &program, const QStringList &arguments, bool checkExitCode);

    /*!
     * Everything the program wrote to its standard output. The buffer is
     * drained: a second call returns an empty string.
     */
    QString output();
};

#endif
