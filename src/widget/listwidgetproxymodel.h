// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_LISTWIDGETPROXYMODEL_H
#define KVT_LISTWIDGETPROXYMODEL_H

#include "elementmodelextension.h"
#include "filtertreenodesortfilterproxymodel.h"

/*!
 * The proxy between a list widget's ElementModel and its view: a
 * FilterTreeNodeSortFilterProxyModel whose indexes can also be turned back
 * into elements. The list widgets use one of its kinds,
 * NodesWidgetProxyModel or ElementsWidgetProxyModel, and pass 1 as the
 * special-flags filter, so supplement elements are not listed.
 */
class KVTCOMMON_EXPORT ListWidgetProxyModel : public FilterTreeNodeSortFilterProxyModel,
                                              public virtual ElementModelExtension
{
    Q_OBJECT

public:
    //! Creates the proxy; \a specialFlagsFilter as for TreeNodeSortFilterProxyModel.
    explicit ListWidgetProxyModel(int specialFlagsFilter, QObject *parent = nullptr);
    //! Destroys the proxy.
    ~ListWidgetProxyModel() override;
};

#endif // KVT_LISTWIDGETPROXYMODEL_H
