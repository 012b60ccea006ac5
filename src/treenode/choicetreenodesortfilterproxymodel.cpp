// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "choicetreenodesortfilterproxymodel.h"

#include "choicetreenodeproxymodel.h"
#include "choicetreenodeproxyhelper_p.h"

namespace {

// Every choice view is built with the filter that hides nodes marked with
// bit 1; this class's own row test looks at the ticked state only.
const int hiddenNodesFilter = 1;

} // namespace

ChoiceTreeNodeSortFilterProxyModel::ChoiceTreeNodeSortFilterProxyModel(bool checked, QObject *parent)
    : TreeNodeSortFilterProxyModel(hiddenNodesFilter, parent)
    , _checked(checked)
{
}

ChoiceTreeNodeSortFilterProxyModel::~ChoiceTreeNodeSortFilterProxyModel() = default;

bool ChoiceTreeNodeSortFilterProxyModel::filterAcceptsRow(int sourceRow,
                                                          const QModelIndex &sourceParent) const
{
    return ChoiceProxyHelper::hasChoiceState(sourceModel(), sourceRow, sourceParent, _checked);
}
