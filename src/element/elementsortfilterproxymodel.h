// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTSORTFILTERPROXYMODEL_H
#define KVT_ELEMENTSORTFILTERPROXYMODEL_H

#include "elementmodelextension.h"
#include "treenodesortfilterproxymodel.h"

/*!
 * A TreeNodeSortFilterProxyModel over an element model (or over another
 * element proxy) whose indexes can also be turned back into elements.
 *
 * Columns and rows are filtered as by TreeNodeSortFilterProxyModel; the
 * arguments of the constructors mean the same.
 */
class KVTCOMMON_EXPORT ElementSortFilterProxyModel : public TreeNodeSortFilterProxyModel,
                                                     public virtual ElementModelExtension
{
    Q_OBJECT

public:
    //! Creates a proxy over every column; see TreeNodeSortFilterProxyModel.
    explicit ElementSortFilterProxyModel(int specialFlagsFilter, QObject *parent = nullptr);
    //! Creates a proxy that shows only the source columns in \a acceptColumns.
    ElementSortFilterProxyModel(QSet<int> acceptColumns, int specialFlagsFilter,
                                QObject *parent = nullptr);
    //! Destroys the proxy.
    ~ElementSortFilterProxyModel() override;
};

#endif // KVT_ELEMENTSORTFILTERPROXYMODEL_H
