// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_FILTERTREENODESORTFILTERPROXYMODEL_H
#define KVT_FILTERTREENODESORTFILTERPROXYMODEL_H

#include "treenodesortfilterproxymodel.h"

/*!
 * A TreeNodeSortFilterProxyModel that also filters rows by the proxy's
 * filter regular expression (filterRegExp()).
 *
 * A row is shown when the expression is found in the display text of one of
 * the accepted columns (of every column when acceptColumns() is empty). An
 * empty or invalid expression filters nothing. Children are not searched: a
 * row that does not match hides its whole subtree.
 */
class KVTCOMMON_EXPORT FilterTreeNodeSortFilterProxyModel : public TreeNodeSortFilterProxyModel
{
    Q_OBJECT

public:
    //! Creates a proxy over every column; see TreeNodeSortFilterProxyModel.
    explicit FilterTreeNodeSortFilterProxyModel(int specialFlagsFilter, QObject *parent = nullptr);
    //! Creates a proxy that shows and searches only the columns in \a acceptColumns.
    FilterTreeNodeSortFilterProxyModel(QSet<int> acceptColumns, int specialFlagsFilter,
                                       QObject *parent = nullptr);
    //! Destroys the proxy.
    ~FilterTreeNodeSortFilterProxyModel() override;

protected:
    //! Accepts a row that passes the flags filter and matches the expression in an accepted column.
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;
};

#endif // KVT_FILTERTREENODESORTFILTERPROXYMODEL_H
