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
    ServiceHeavyElementData();
    ServiceHeavyElementData(const ServiceHeavyElementData &other);
    ServiceHeavyElementData &operator=(const ServiceHeavyElementData &other);
    ~ServiceHeavyElementData() override;

    /*! The owned nodes, modifiable in place. A node put here is destroyed
     *  with the record; take it out first to keep it. */
    QList<TreeNode *> &data() { return _data; }

    const QString &configFile() const { return _configFile; }
    void setConfigFile(const QString &configFile) { _configFile = configFile; }
    const QString &configData() const { return _configData; }
    void setConfigData(const QString &configData) { _configData = configData; }

protected:
    QList<TreeNode *> _data;
    QString _configData;
    QString _configFile;
};

#endif // KVT_SERVICEHEAVYELEMENTDATA_H
