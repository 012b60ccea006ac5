#ifndef KVT_FILTERTREENODESORTFILTERPROXYMODEL_H
#define KVT_FILTERTREENODESORTFILTERPROXYMODEL_H

#include "treenodesortfilterproxymodel.h"

/*!
 * A TreeNodeSortFilterProxyModel that also filters rows by the proxy's
 * filter regular expression (filterRegExp()).
 *
 * A row is shown when the expression is found in the display text of one of
 * the accepted columns (of every column when acceptColumns() is empty). An
 * empty or invalid expression filters nothing. Children are not searched: a
 * row that does not match hides its whole subtree.
 */
class KVTCOMMON_EXPORT FilterTreeNodeSortFilterProxyModel : public TreeNodeSortFilterProxyModel
{
    Q_OBJECT

public:
    explicit FilterTreeNodeSortFilterProxyModel(int specialFlagsFilter, QObject *parent = nullptr);
    FilterTreeNodeSortFilterProxyModel(QSet<int> acceptColumns, int specialFlagsFilter,
                                       QObject *parent = nullptr);
    ~FilterTreeNodeSortFilterProxyModel() override;

protected:
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;
};

#endif // KVT_FILTERTREENODESORTFILTERPROXYMODEL_H
