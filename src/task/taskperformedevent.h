// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TASKPERFORMEDEVENT_H
#define KVT_TASKPERFORMEDEVENT_H

#include "kvtcommon_export.h"

#include <QEvent>

class AbstractTask;

/*!
 * Posted by a task at the end of its run() (event type 1002); the task
 * observer receives it in the interface thread. Does not own the task.
 */
class KVTCOMMON_EXPORT TaskPerformedEvent : public QEvent
{
public:
    //! The event type, 1002.
    static const QEvent::Type EventType = QEvent::Type(1002);

    //! Creates the completion event of \a task.
    explicit TaskPerformedEvent(AbstractTask *task);
    //! Destroys the event, not the task.
    ~TaskPerformedEvent() override;

    //! The task that has run.
    AbstractTask *task() const { return _task; }

private:
    AbstractTask *_task;
};

#endif // KVT_TASKPERFORMEDEVENT_H
