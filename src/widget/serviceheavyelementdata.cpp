// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "serviceheavyelementdata.h"

#include "treenode.h"

#include <QPointer>
#include <QVector>

ServiceHeavyElementData::ServiceHeavyElementData() = default;

// The node list is left out on purpose: see the class comment.
ServiceHeavyElementData::ServiceHeavyElementData(const ServiceHeavyElementData &other)
    : ServiceLightElementData(other)
    , _configData(other._configData)
    , _configFile(other._configFile)
{
}

ServiceHeavyElementData &ServiceHeavyElementData::operator=(const ServiceHeavyElementData &other)
{
    if (&other != this) {
        ServiceLightElementData::operator=(other);
        _configData = other._configData;
        _configFile = other._configFile;
    }
    return *this;
}

ServiceHeavyElementData::~ServiceHeavyElementData()
{
    // Guarded pointers first: a node listed twice, or listed together with
    // one of its descendants, is gone after the first deletion and must not
    // be deleted again.
    QVector<QPointer<TreeNode>> nodes;
    nodes.reserve(_data.size());
    for (TreeNode *node : qAsConst(_data))
        nodes.append(node);
    _data.clear();
    for (const QPointer<TreeNode> &node : qAsConst(nodes)) {
        if (!node)
            continue;
        node->clearDeleteAll();
        delete node.data();
    }
}
