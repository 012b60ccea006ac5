// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "selectableelementsortfilterproxymodel.h"

namespace {

// Shows only the nodes whose special flags have bit 2.
const int showOnlyMarkedNodes = 2;

} // namespace

SelectableElementSortFilterProxyModel::SelectableElementSortFilterProxyModel(QObject *parent)
    : SelectableElementSortFilterProxyModel(QSet<int>(), parent)
{
}

SelectableElementSortFilterProxyModel::SelectableElementSortFilterProxyModel(QSet<int> acceptColumns,
                                                                             QObject *parent)
    : ElementSortFilterProxyModel(std::move(acceptColumns), showOnlyMarkedNodes, parent)
    , _selectionDisplayRole(Qt::DisplayRole)
{
}

SelectableElementSortFilterProxyModel::~SelectableElementSortFilterProxyModel() = default;

int SelectableElementSortFilterProxyModel::selectionDisplayRole() const
{
    return _selectionDisplayRole;
}

void SelectableElementSortFilterProxyModel::setSelectionDisplayRole(int role)
{
    _selectionDisplayRole = role;
}

QVariant SelectableElementSortFilterProxyModel::data(const QModelIndex &index, int role) const
{
    if (role == Qt::DisplayRole)
        role = _selectionDisplayRole;
    return QSortFilterProxyModel::data(index, role);
}
