#ifndef KVT_PLUGIN_H
#define KVT_PLUGIN_H

#include "kvtcommon_export.h"

#include <QList>
#include <QObject>
#include <QString>
#include <QtGlobal>

class Plugin;

/*!
 * The interface id every plugin's root object answers. A plugin declares it
 * in its metadata: Q_PLUGIN_METADATA(IID "brel-admin-kvt/0.0").
 */
#define KVT_PLUGIN_IID "brel-admin-kvt/0.0"

Q_DECLARE_INTERFACE(Plugin, KVT_PLUGIN_IID)

/*!
 * Base of every plugin's root object, the instance that the plugin loader
 * hands out.
 *
 * A plugin fills the fields in its own constructor: a display name, a
 * sentence for the plugin list, the bit mask of the classes of operation
 * its modules offer, and its modules. The modules are QObject children of
 * the plugin (or otherwise owned by it); the base does not delete them.
 * Objects in modules() that are not Module objects are ignored.
 *
 * A plugin that cannot work on the current host returns false from
 * isValid(): it is unloaded and offers nothing. Its dynamic property
 * "unavailableReason" (a sentence, set in its constructor) is added to what
 * the plugin list says of the refused file.
 */
class KVTCOMMON_EXPORT Plugin : public QObject
{
    Q_OBJECT
    Q_INTERFACES(Plugin)

public:
    explicit Plugin(QObject *parent = nullptr);
    ~Plugin() override;

    // Virtual interface added to QObject's; the order of declaration is part
    // of the binary interface that plugins are built against.
    virtual bool isValid() const;

    quint64 availableOperationsClass() const { return _availableOperationsClass; }
    QString name() const { return _name; }
    QString description() const { return _description; }
    QList<QObject *> &modules() { return _modules; }
    const QList<QObject *> &modules() const { return _modules; }

protected:
    quint64 _availableOperationsClass;
    QString _name;
    QString _description;
    QList<QObject *> _modules;
};

#endif // KVT_PLUGIN_H
