#ifndef KVT_TREENODESORTFILTERPROXYMODEL_H
#define KVT_TREENODESORTFILTERPROXYMODEL_H

#include "treenodemodelextension.h"

#include <QSet>
#include <QSortFilterProxyModel>

/*!
 * A sorting and filtering proxy over a tree-node model (a TreeNodeModel or
 * another proxy over one) that still maps its indexes to nodes.
 *
 * Columns are shown only when they are among acceptColumns() (all of them
 * when the set is empty). Rows are filtered by the special flags of their
 * nodes, as chosen by the bits of specialFlagsFilter:
 * - bit 1: nodes whose flags have bit 1 are hidden;
 * - bit 2: only nodes whose flags have bit 2 are shown.
 *
 * The node mapping is answered by the source model; over a source that is
 * not a tree-node model, every row is shown and no index maps to a node.
 */
class KVTCOMMON_EXPORT TreeNodeSortFilterProxyModel : public QSortFilterProxyModel,
                                                      public virtual TreeNodeModelExtension
{
    Q_OBJECT

public:
    explicit TreeNodeSortFilterProxyModel(int specialFlagsFilter, QObject *parent = nullptr);
    TreeNodeSortFilterProxyModel(QSet<int> acceptColumns, int specialFlagsFilter,
                                 QObject *parent = nullptr);
    ~TreeNodeSortFilterProxyModel() override;

    int specialFlagsFilter() const { return _specialFlagsFilter; }
    QSet<int> acceptColumns() const;
    void setAcceptColumns(const QSet<int> &acceptColumns);

    TreeNode *rootNode() const override;
    TreeNode *toTreeNode(const QModelIndex &index) const override;
    TreeNode *toTreeNode(const QItemSelectionRange &range) const override;
    TreeNode *toTreeNode(const QItemSelection &selection) const override;
    QModelIndex treeNodeToIndex(TreeNode *node) const override;

protected:
    bool filterAcceptsColumn(int sourceColumn, const QModelIndex &sourceParent) const override;
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;

    int _specialFlagsFilter;
    QSet<int> _acceptColumns;
};

#endif // KVT_TREENODESORTFILTERPROXYMODEL_H
