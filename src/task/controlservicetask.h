// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CONTROLSERVICETASK_H
#define KVT_CONTROLSERVICETASK_H

#include "elementtask.h"

#include <QCoreApplication>
#include <QStringList>

/*!
 * Launches a program detached, as the current user or, when user() is set,
 * as that user through "runuser -u". The task succeeds as soon as the
 * program is launched; its exit code is never known.
 *
 * existPackage() tells whether a Debian package is installed.
 */
class KVTCOMMON_EXPORT ControlServiceTask : public ElementTask
{
    Q_DECLARE_TR_FUNCTIONS(ControlServiceTask)

public:
    //! Creates a task for \a element; set the program, arguments and user before starting it.
    explicit ControlServiceTask(Element *element);
    //! Destroys the task.
    ~ControlServiceTask() override;

    /*!
     * Launches the program detached and succeeds once it is launched; fails with a message otherwise.
     */
    void run() override;
    //! Does nothing: the outcome of the detached program is not known.
    void afterRun() override;

    //! The user to run as; empty means the current user.
    const QString &user() const { return _user; }
    //! Runs the program as \a user through "runuser -u" (needs administrator rights).
    void setUser(const QString &user) { _user = user; }
    /*! A string the creator keeps with the task; the library never reads it. */
    const QString &extra() const { return _extra; }
    //! Sets the string kept with the task.
    void setExtra(const QString &extra) { _extra = extra; }
    //! The program to launch.
    const QString &program() const { return _program; }
    //! Sets the program to launch.
    void setProgram(const QString &program) { _program = program; }
    //! The program's arguments.
    const QStringList &arguments() const { return _arguments; }
    //! Sets the program's arguments.
    void setArguments(const QStringList &arguments) { _arguments = arguments; }

    /*! Whether the package \a name is installed: dpkg-query lists it with the
     *  status letters "ii". The name is matched as written ("libstdc++6"),
     *  except that dpkg-query's wildcards "*", "?" and "[...]" keep their
     *  meaning. False when dpkg-query is missing, fails or does not answer
     *  within 30 seconds. */
    static bool existPackage(const QString &name);

protected:
    //! See user().
    QString _user;
    //! See extra().
    QString _extra;
    //! See program().
    QString _program;
    //! See arguments().
    QStringList _arguments;
};

#endif // KVT_CONTROLSERVICETASK_H
