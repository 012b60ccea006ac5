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
    static const QEvent::Type EventType = QEvent::Type(1001);

    explicit StartEvent(const QString &pluginPath);
    ~StartEvent() override;

    QString pluginPath() const { return _pluginPath; }

private:
    QString _pluginPath;
};

#endif // KVT_STARTEVENT_H
