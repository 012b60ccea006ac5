#include "filtertreenodesortfilterproxymodel.h"

#include <QRegExp>

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
    if (!TreeNodeSortFilterProxyModel::filterAcceptsRow(sourceRow, sourceParent))
        return false;
    const QRegExp regExp = filterRegExp();
    if (regExp.isEmpty() || !regExp.isValid())
        return true;
    const QAbstractItemModel *source = sourceModel();
    if (!source)
        return true;

    QList<int> columns = _acceptColumns.values();
    if (columns.isEmpty()) {
        const int count = source->columnCount(sourceParent);
        for (int column = 0; column < count; ++column)
            columns.append(column);
    }
    for (int column : qAsConst(columns)) {
        const QModelIndex index = source->index(sourceRow, column, sourceParent);
        if (!index.isValid())
            continue;
        if (index.data(Qt::DisplayRole).toString().indexOf(regExp) != -1)
            return true;
    }
    return false;
}
