// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_RECORDSORTFILTERPROXYMODEL_H
#define KVT_RECORDSORTFILTERPROXYMODEL_H

#include "kvtcommon_export.h"

#include <QSortFilterProxyModel>

/*!
 * Filters a record table by the proxy's filter regular expression
 * (filterRegExp()): a row is shown when the expression is found in the
 * display text of any of its columns. The filter key column plays no part.
 * An empty or invalid expression shows every row.
 */
class KVTCOMMON_EXPORT RecordSortFilterProxyModel : public QSortFilterProxyModel
{
    Q_OBJECT

public:
    //! Creates the proxy.
    explicit RecordSortFilterProxyModel(QObject *parent = nullptr);
    //! Destroys the proxy.
    ~RecordSortFilterProxyModel() override;

protected:
    //! Accepts a row whose display text matches the expression in some column.
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;
};

#endif // KVT_RECORDSORTFILTERPROXYMODEL_H
