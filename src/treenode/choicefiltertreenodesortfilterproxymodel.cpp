// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "choicefiltertreenodesortfilterproxymodel.h"

#include "choicetreenodeproxyhelper_p.h"

namespace {

const int hiddenNodesFilter = 1;

} // namespace

ChoiceFilterTreeNodeSortFilterProxyModel::ChoiceFilterTreeNodeSortFilterProxyModel(bool checked,
                                                                                   QObject *parent)
    : FilterTreeNodeSortFilterProxyModel(hiddenNodesFilter, parent)
    , _checked(checked)
{
}

ChoiceFilterTreeNodeSortFilterProxyModel::~ChoiceFilterTreeNodeSortFilterProxyModel() = default;

bool ChoiceFilterTreeNodeSortFilterProxyModel::filterAcceptsRow(int sourceRow,
                                                                const QModelIndex &sourceParent) const
{
    if (!FilterTreeNodeSortFilterProxyModel::filterAcceptsRow(sourceRow, sourceParent))
        return false;
    return ChoiceProxyHelper::hasChoiceState(sourceModel(), sourceRow, sourceParent, _checked);
}
