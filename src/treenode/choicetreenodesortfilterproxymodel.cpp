#include "choicetreenodesortfilterproxymodel.h"

#include "choicetreenodeproxymodel.h"
#include "choicetreenodeproxyhelper_p.h"

namespace {

// Hides the nodes whose special flags have bit 1, like every choice view;
// the row test below does not ask for it, though.
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
