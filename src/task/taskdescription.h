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
    enum TaskStatus : qint32 {
        Processing = 0,
        Fail = 1,
        Success = 2,
        Warning = 3,
        AboutToBeStopped = 4
    };

    TaskDescription() = default;

    QString description() const { return _description; }
    void setDescription(const QString &description) { _description = description; }
    TaskStatus status() const { return _status; }
    void setStatus(const TaskStatus &status) { _status = status; }
    QString message() const { return _message; }
    void setMessage(const QString &message) { _message = message; }

private:
    QString _description;
    TaskStatus _status = Processing;
    QString _message;
};

#endif // KVT_TASKDESCRIPTION_H
