// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_SERVICECONFIGUREHEAVYELEMENTDATA_H
#define KVT_SERVICECONFIGUREHEAVYELEMENTDATA_H

#include "servicelightelementdata.h"

#include <QMap>
#include <QSet>
#include <QStringList>

/*!
 * State and configuration choices of a configurable service. The library
 * only stores, copies and frees these fields; their meaning is the plugins'.
 *
 * Copy construction leaves incompatibleModes() empty while assignment copies
 * it. The difference is intended: a record built from another one starts
 * without the other's incompatibilities, an assigned one takes everything.
 */
class KVTCOMMON_EXPORT ServiceConfigureHeavyElementData : public ServiceLightElementData
{
public:
    //! Creates an empty record.
    ServiceConfigureHeavyElementData();
    /*!
     * Copies everything but incompatibleModes(), which starts empty; assignment
     * copies it too.
     */
    ServiceConfigureHeavyElementData(const ServiceConfigureHeavyElementData &other);
    //! Copies everything, incompatibleModes() included.
    ServiceConfigureHeavyElementData &operator=(const ServiceConfigureHeavyElementData &other);
    //! Destroys the record.
    ~ServiceConfigureHeavyElementData() override;

    //! Commands of the service's configuration script, modifiable in place.
    QStringList &scriptModeCommands() { return _scriptModeCommands; }
    //! Column headers of the configuration list, modifiable in place.
    QStringList &headers() { return _headers; }
    //! Descriptions of the configuration items, modifiable in place.
    QStringList &descriptions() { return _descriptions; }
    //! Configuration tasks by name, modifiable in place.
    QMap<QString, QString> &tasks() { return _tasks; }
    //! Items switched on, modifiable in place.
    QSet<QString> &checkedItems() { return _checkedItems; }
    //! Items switched off, modifiable in place.
    QSet<QString> &uncheckedItems() { return _uncheckedItems; }
    //! Modes that cannot be combined, modifiable in place.
    QSet<QString> &incompatibleModes() { return _incompatibleModes; }

    //! The user the configuration runs as.
    QString user() const { return _user; }
    //! Sets the user.
    void setUser(const QString &user) { _user = user; }
    //! The password of user().
    QString password() const { return _password; }
    //! Sets the password.
    void setPassword(const QString &password) { _password = password; }

protected:
    //! See scriptModeCommands().
    QStringList _scriptModeCommands;
    //! See headers().
    QStringList _headers;
    //! See descriptions().
    QStringList _descriptions;
    //! See tasks().
    QMap<QString, QString> _tasks;
    //! See user().
    QString _user;
    //! See password().
    QString _password;
    //! See checkedItems().
    QSet<QString> _checkedItems;
    //! See uncheckedItems().
    QSet<QString> _uncheckedItems;
    //! See incompatibleModes().
    QSet<QString> _incompatibleModes;
};

#endif // KVT_SERVICECONFIGUREHEAVYELEMENTDATA_H
