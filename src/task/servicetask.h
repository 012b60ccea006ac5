// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_SERVICETASK_H
#define KVT_SERVICETASK_H

#include "elementtask.h"

#include <QCoreApplication>
#include <QStringList>

/*!
 * Base of the tasks that query or control a system service by running its
 * control program and reading the exit code.
 *
 * The creator sets program() and arguments() (typically the service's
 * name); the subclass fixes the command word ("status", "start", ...), which
 * goes before the arguments, or after them with setCommandFirst(false).
 *
 * With a ServiceLightElementData record the task is a status query: the
 * exit code only selects the state (0 running, anything else stopped) and
 * the task succeeds. Without one, any exit code other than 0 fails the task
 * with the program's standard error. A program that does not start, does not
 * finish or crashes fails the task too. There is no time limit on the
 * program once it runs.
 */
class KVTCOMMON_EXPORT ServiceTask : public ElementTask
{
    Q_DECLARE_TR_FUNCTIONS(ServiceTask)

public:
    //! Creates a task for \a element owning \a data; program and arguments start empty.
    ServiceTask(Element *element, ElementData *data = nullptr);
    //! Destroys the task and its record.
    ~ServiceTask() override;

    /*!
     * Runs program() with commandLine() in the worker thread (waiting up to 30
     * seconds for it to start), sets the status and message as described above and
     * posts the completion.
     */
    void run() override;

    //! Whether the command word goes before the arguments (the default).
    bool commandFirst() const { return _commandFirst; }
    //! Puts the command word before (true) or after (false) the arguments.
    void setCommandFirst(bool first) { _commandFirst = first; }
    //! The control program to run; the creator sets it.
    const QString &program() const { return _program; }
    //! Sets the control program, for instance "/usr/sbin/service".
    void setProgram(const QString &program) { _program = program; }
    //! The command word fixed by the subclass ("status", "start", ...).
    const QString &command() const { return _command; }
    //! Further arguments, typically the service's name.
    const QStringList &arguments() const { return _arguments; }
    //! Sets the further arguments.
    void setArguments(const QStringList &arguments) { _arguments = arguments; }

    /*! The arguments the program is started with: the command word and the
     *  arguments in the order commandFirst() says. */
    QStringList commandLine() const;

protected:
    //! See commandFirst().
    bool _commandFirst;
    //! See program().
    QString _program;
    //! See command(); a subclass sets it in its constructor.
    QString _command;
    //! See arguments().
    QStringList _arguments;
};

#endif // KVT_SERVICETASK_H
