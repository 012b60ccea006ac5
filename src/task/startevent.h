// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_STARTEVENT_H
#define KVT_STARTEVENT_H

#include "kvtcommon_export.h"

#include <QEvent>
#include <QString>

/*!
 * An event (type 1001) an application may post to start work on a plugin
 * path. The library defines it but neither posts nor handles it.
 */
class KVTCOMMON_EXPORT StartEvent : public QEvent
{
public:
    //! The event type, 1001.
    static const QEvent::Type EventType = QEvent::Type(1001);

    //! Creates the event for \a pluginPath.
    explicit StartEvent(const QString &pluginPath);
    //! Destroys the event.
    ~StartEvent() override;

    //! The plugin path given to the constructor.
    QString pluginPath() const { return _pluginPath; }

private:
    QString _pluginPath;
};

#endif // KVT_STARTEVENT_H
