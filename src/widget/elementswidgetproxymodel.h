// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTSWIDGETPROXYMODEL_H
#define KVT_ELEMENTSWIDGETPROXYMODEL_H

#include "listwidgetproxymodel.h"

/*!
 * The proxy of ElementsElementWidget: lists the first level below the root,
 * in every column but the first, and filters the rows by the proxy's filter
 * expression.
 *
 * Column 0 (the node's own id) is neither shown nor searched: a row is
 * listed when the expression is found in the display text of one of the
 * columns 1 to n - 1. A source with a single column therefore lists no row
 * at all once a valid, non-empty expression is set. An empty or invalid
 * expression filters nothing.
 */
class KVTCOMMON_EXPORT ElementsWidgetProxyModel : public ListWidgetProxyModel
{
    Q_OBJECT

public:
    //! Creates the proxy; \a specialFlagsFilter as for TreeNodeSortFilterProxyModel.
    explicit ElementsWidgetProxyModel(int specialFlagsFilter, QObject *parent = nullptr);
    //! Destroys the proxy.
    ~ElementsWidgetProxyModel() override;

protected:
    //! Hides the first column.
    bool filterAcceptsColumn(int sourceColumn, const QModelIndex &sourceParent) const override;
    //! Accepts the first level below the root that passes the flags filter and matches the expression.
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;
};

#endif // KVT_ELEMENTSWIDGETPROXYMODEL_H
