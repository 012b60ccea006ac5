#include "elementsortfilterproxymodel.h"

ElementSortFilterProxyModel::ElementSortFilterProxyModel(int specialFlagsFilter, QObject *parent)
    : TreeNodeSortFilterProxyModel(specialFlagsFilter, parent)
{
}

ElementSortFilterProxyModel::ElementSortFilterProxyModel(QSet<int> acceptColumns,
                                                         int specialFlagsFilter, QObject *parent)
    : TreeNodeSortFilterProxyModel(std::move(acceptColumns), specialFlagsFilter, parent)
{
}

ElementSortFilterProxyModel::~ElementSortFilterProxyModel() = default;
