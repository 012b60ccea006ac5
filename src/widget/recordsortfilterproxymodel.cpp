// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "recordsortfilterproxymodel.h"

#include <QRegExp>

RecordSortFilterProxyModel::RecordSortFilterProxyModel(QObject *parent)
    : QSortFilterProxyModel(parent)
{
}

RecordSortFilterProxyModel::~RecordSortFilterProxyModel() = default;

bool RecordSortFilterProxyModel::filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const
{
    const QAbstractItemModel *source = sourceModel();
    if (!source)
        return false;
    const QRegExp regExp = filterRegExp();
    if (regExp.isEmpty() || !regExp.isValid())
        return true;
    const int columns = source->columnCount(sourceParent);
    for (int column = 0; column < columns; ++column) {
        const QModelIndex index = source->index(sourceRow, column, sourceParent);
        if (index.data(Qt::DisplayRole).toString().indexOf(regExp) != -1)
            return true;
    }
    return false;
}
