#include "elementswidgetproxymodel.h"

#include <QRegExp>

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
    if (sourceParent.isValid())
        return false;
    if (!TreeNodeSortFilterProxyModel::filterAcceptsRow(sourceRow, sourceParent))
        return false;
    const QRegExp regExp = filterRegExp();
    if (regExp.isEmpty() || !regExp.isValid())
        return true;
    const QAbstractItemModel *source = sourceModel();
    if (!source)
        return true;
    const int count = source->columnCount(sourceParent);
    for (int column = 1; column < count; ++column) {
        const QModelIndex index = source->index(sourceRow, column, sourceParent);
        if (index.data(Qt::DisplayRole).toString().indexOf(regExp) != -1)
            return true;
    }
    return false;
}
