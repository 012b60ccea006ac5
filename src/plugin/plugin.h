// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PLUGIN_H
#define KVT_PLUGIN_H

#include "kvtcommon_export.h"

#include <QList>
#include <QObject>
#include <QString>
#include <QtGlobal>

/*! \file plugin.h
 * The plugin interface: the Plugin base class and its interface id.
 */

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
    //! Creates an empty plugin: no name, no modules, operation classes 0.
    explicit Plugin(QObject *parent = nullptr);
    //! Destroys the plugin, and with it the modules that are its QObject children.
    ~Plugin() override;

    // Virtual interface added to QObject's; the order of declaration is part
    // of the binary interface that plugins are built against.
    /*!
     * Whether the plugin can work on this host (a program or file it needs is
     * there). True in the base. A plugin that is not valid is unloaded at once and
     * shows as refused in the plugin list.
     */
    virtual bool isValid() const;

    //! The bit mask of the classes of operation the plugin's modules offer.
    quint64 availableOperationsClass() const { return _availableOperationsClass; }
    //! The plugin's display name.
    QString name() const { return _name; }
    //! A sentence for the plugin list.
    QString description() const { return _description; }
    //! The plugin's modules; the constructor appends them.
    QList<QObject *> &modules() { return _modules; }
    //! The plugin's modules.
    const QList<QObject *> &modules() const { return _modules; }

protected:
    //! See availableOperationsClass(); set by the plugin's constructor.
    quint64 _availableOperationsClass;
    //! See name(); set by the plugin's constructor (translated).
    QString _name;
    //! See description(); set by the plugin's constructor (translated).
    QString _description;
    //! See modules(); the plugin's constructor appends its Module objects, created as its children.
    QList<QObject *> _modules;
};

#endif // KVT_PLUGIN_H
