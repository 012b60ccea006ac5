// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TASKDESCRIPTION_H
#define KVT_TASKDESCRIPTION_H

#include "kvtcommon_export.h"

#include <QString>

/*!
 * What the task list shows of a task: its name, its status and the message
 * of its outcome.
 */
class KVTCOMMON_EXPORT TaskDescription
{
public:
    //! The state of a task in the list.
    enum TaskStatus : qint32 {
        //! Queued or running; every task starts so.
        Processing = 0,
        //! Failed; the message says why.
        Fail = 1,
        //! Done.
        Success = 2,
        //! Done, with something the user should read in the message.
        Warning = 3,
        //! The user asked a stoppable task to stop; shown until it ends.
        AboutToBeStopped = 4
    };

    //! An unnamed description with status Processing and no message.
    TaskDescription() = default;

    //! The task's name, shown in the "Task" column.
    QString description() const { return _description; }
    //! Sets the task's name; a task sets it in its constructor.
    void setDescription(const QString &description) { _description = description; }
    //! The status, shown in the "Status" column.
    TaskStatus status() const { return _status; }
    //! Sets the status; run() sets a final one before it ends.
    void setStatus(const TaskStatus &status) { _status = status; }
    //! The outcome text, shown in the "Message" column and in the message page of the task dialog.
    QString message() const { return _message; }
    //! Sets the outcome text.
    void setMessage(const QString &message) { _message = message; }

private:
    QString _description;
    TaskStatus _status = Processing;
    QString _message;
};

#endif // KVT_TASKDESCRIPTION_H
