// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "filtertreenodesortfilterproxymodel.h"

#include "treenodeproxyhelper_p.h"

FilterTreeNodeSortFilterProxyModel::FilterTreeNodeSortFilterProxyModel(int specialFlagsFilter,
                                                                       QObject *parent)
    : TreeNodeSortFilterProxyModel(specialFlagsFilter, parent)
{
}

FilterTreeNodeSortFilterProxyModel::FilterTreeNodeSortFilterProxyModel(QSet<int> acceptColumns,
                                                                       int specialFlagsFilter,
                                                                       QObject *parent)
    : TreeNodeSortFilterProxyModel(std::move(acceptColumns), specialFlagsFilter, parent)
{
}

FilterTreeNodeSortFilterProxyModel::~FilterTreeNodeSortFilterProxyModel() = default;

bool FilterTreeNodeSortFilterProxyModel::filterAcceptsRow(int sourceRow,
                                                          const QModelIndex &sourceParent) const
{
    return TreeNodeSortFilterProxyModel::filterAcceptsRow(sourceRow, sourceParent)
           && TreeNodeProxyHelper::textFilterAccepts(this, sourceRow, sourceParent, _acceptColumns);
}
