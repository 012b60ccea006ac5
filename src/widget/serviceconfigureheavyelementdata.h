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
    ServiceConfigureHeavyElementData();
    ServiceConfigureHeavyElementData(const ServiceConfigureHeavyElementData &other);
    ServiceConfigureHeavyElementData &operator=(const ServiceConfigureHeavyElementData &other);
    ~ServiceConfigureHeavyElementData() override;

    QStringList &scriptModeCommands() { return _scriptModeCommands; }
    QStringList &headers() { return _headers; }
    QStringList &descriptions() { return _descriptions; }
    QMap<QString, QString> &tasks() { return _tasks; }
    QSet<QString> &checkedItems() { return _checkedItems; }
    QSet<QString> &uncheckedItems() { return _uncheckedItems; }
    QSet<QString> &incompatibleModes() { return _incompatibleModes; }

    QString user() const { return _user; }
    void setUser(const QString &user) { _user = user; }
    QString password() const { return _password; }
    void setPassword(const QString &password) { _password = password; }

protected:
    QStringList _scriptModeCommands;
    QStringList _headers;
    QStringList _descriptions;
    QMap<QString, QString> _tasks;
    QString _user;
    QString _password;
    QSet<QString> _checkedItems;
    QSet<QString> _uncheckedItems;
    QSet<QString> _incompatibleModes;
};

#endif // KVT_SERVICECONFIGUREHEAVYELEMENTDATA_H
