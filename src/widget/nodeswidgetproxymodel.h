// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_NODESWIDGETPROXYMODEL_H
#define KVT_NODESWIDGETPROXYMODEL_H

#include "listwidgetproxymodel.h"

/*!
 * The proxy of NodesElementWidget: lists the first level below the root
 * only, filtered by special flags as TreeNodeSortFilterProxyModel does. The
 * text filter of the base is not applied.
 */
class KVTCOMMON_EXPORT NodesWidgetProxyModel : public ListWidgetProxyModel
{
    Q_OBJECT

public:
    //! Creates the proxy; \a specialFlagsFilter as for TreeNodeSortFilterProxyModel.
    explicit NodesWidgetProxyModel(int specialFlagsFilter, QObject *parent = nullptr);
    //! Destroys the proxy.
    ~NodesWidgetProxyModel() override;

protected:
    //! Accepts the first level below the root that passes the special-flags filter.
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;
};

#endif // KVT_NODESWIDGETPROXYMODEL_H
