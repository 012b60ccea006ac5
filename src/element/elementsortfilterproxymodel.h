#ifndef KVT_ELEMENTSORTFILTERPROXYMODEL_H
#define KVT_ELEMENTSORTFILTERPROXYMODEL_H

#include "elementmodelextension.h"
#include "treenodesortfilterproxymodel.h"

/*!
 * A TreeNodeSortFilterProxyModel over an element model (or over another
 * element proxy) whose indexes can also be turned back into elements.
 *
 * Columns and rows are filtered as by TreeNodeSortFilterProxyModel; the
 * arguments of the constructors mean the same.
 */
class KVTCOMMON_EXPORT ElementSortFilterProxyModel : public TreeNodeSortFilterProxyModel,
                                                     public virtual ElementModelExtension
{
    Q_OBJECT

public:
    explicit ElementSortFilterProxyModel(int specialFlagsFilter, QObject *parent = nullptr);
    ElementSortFilterProxyModel(QSet<int> acceptColumns, int specialFlagsFilter,
                                QObject *parent = nullptr);
    ~ElementSortFilterProxyModel() override;
};

#endif // KVT_ELEMENTSORTFILTERPROXYMODEL_H
