#ifndef KVT_CHOICEFILTERTREENODESORTFILTERPROXYMODEL_H
#define KVT_CHOICEFILTERTREENODESORTFILTERPROXYMODEL_H

#include "filtertreenodesortfilterproxymodel.h"

/*!
 * Shows either the ticked or the unticked rows of a ChoiceTreeNodeProxyModel
 * (its source), among those that pass the special-flags filter and the text
 * filter of FilterTreeNodeSortFilterProxyModel. Nodes whose special flags
 * have bit 1 are hidden.
 */
class KVTCOMMON_EXPORT ChoiceFilterTreeNodeSortFilterProxyModel : public FilterTreeNodeSortFilterProxyModel
{
    Q_OBJECT

public:
    explicit ChoiceFilterTreeNodeSortFilterProxyModel(bool checked, QObject *parent = nullptr);
    ~ChoiceFilterTreeNodeSortFilterProxyModel() override;

    bool checked() const { return _checked; }

protected:
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;

    bool _checked;
};

#endif // KVT_CHOICEFILTERTREENODESORTFILTERPROXYMODEL_H
