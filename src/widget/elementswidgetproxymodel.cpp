// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementswidgetproxymodel.h"

#include "treenodeproxyhelper_p.h"

ElementsWidgetProxyModel::ElementsWidgetProxyModel(int specialFlagsFilter, QObject *parent)
    : ListWidgetProxyModel(specialFlagsFilter, parent)
{
}

ElementsWidgetProxyModel::~ElementsWidgetProxyModel() = default;

bool ElementsWidgetProxyModel::filterAcceptsColumn(int sourceColumn, const QModelIndex &) const
{
    // Column 0 holds the id the tree is built by, which means nothing to the
    // user of a list; the accept columns of the base are not consulted.
    return sourceColumn > 0;
}

bool ElementsWidgetProxyModel::filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const
{
    // Only the first level, and column 0 is never searched: a source with a
    // single column keeps no row once a filter is set.
    return !sourceParent.isValid()
           && TreeNodeSortFilterProxyModel::filterAcceptsRow(sourceRow, sourceParent)
           && TreeNodeProxyHelper::textFilterAccepts(this, sourceRow, sourceParent, QSet<int>(), 1);
}
