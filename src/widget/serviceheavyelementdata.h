// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_SERVICEHEAVYELEMENTDATA_H
#define KVT_SERVICEHEAVYELEMENTDATA_H

#include "servicelightelementdata.h"

#include <QList>

class TreeNode;

/*!
 * The full data of a service: its state, the nodes that describe its data
 * and its configuration file.
 *
 * The record owns every node of data() and the subtrees beneath them, and
 * destroys them with itself. For that reason the node list is never copied:
 * a copy (constructed or assigned) takes the state and the configuration
 * but keeps a node list of its own, so no node ever has two owners.
 */
class KVTCOMMON_EXPORT ServiceHeavyElementData : public ServiceLightElementData
{
public:
    //! Creates an empty record.
    ServiceHeavyElementData();
    //! Copies everything but the nodes: the new record's data() starts empty.
    ServiceHeavyElementData(const ServiceHeavyElementData &other);
    //! Copies everything but the nodes: data() is left as it was.
    ServiceHeavyElementData &operator=(const ServiceHeavyElementData &other);
    //! Deletes every node of data() with its whole subtree.
    ~ServiceHeavyElementData() override;

    /*! The owned nodes, modifiable in place. A node put here is destroyed
     *  with the record; take it out first to keep it. */
    QList<TreeNode *> &data() { return _data; }

    //! The path of the service's configuration file.
    const QString &configFile() const { return _configFile; }
    //! Sets the path of the configuration file.
    void setConfigFile(const QString &configFile) { _configFile = configFile; }
    //! The text of the configuration file.
    const QString &configData() const { return _configData; }
    //! Sets the text of the configuration file.
    void setConfigData(const QString &configData) { _configData = configData; }

protected:
    //! See data(); the nodes are owned.
    QList<TreeNode *> _data;
    //! See configData().
    QString _configData;
    //! See configFile().
    QString _configFile;
};

#endif // KVT_SERVICEHEAVYELEMENTDATA_H
