#ifndef KVT_CHOICETREENODESORTFILTERPROXYMODEL_H
#define KVT_CHOICETREENODESORTFILTERPROXYMODEL_H

#include "treenodesortfilterproxymodel.h"

/*!
 * Shows either the ticked or the unticked rows of a ChoiceTreeNodeProxyModel
 * (its source): the ticked ones when checked() is true.
 *
 * Over any other source every row is shown. The row test looks at the ticked
 * state only; the special flags of the nodes are not consulted.
 */
class KVTCOMMON_EXPORT ChoiceTreeNodeSortFilterProxyModel : public TreeNodeSortFilterProxyModel
{
    Q_OBJECT

public:
    explicit ChoiceTreeNodeSortFilterProxyModel(bool checked, QObject *parent = nullptr);
    ~ChoiceTreeNodeSortFilterProxyModel() override;

    bool checked() const { return _checked; }

protected:
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;

    bool _checked;
};

#endif // KVT_CHOICETREENODESORTFILTERPROXYMODEL_H
