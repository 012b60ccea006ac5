// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    //! Creates a proxy that shows every column and filters rows by \a specialFlagsFilter.
    explicit TreeNodeSortFilterProxyModel(int specialFlagsFilter, QObject *parent = nullptr);
    //! Creates a proxy that shows only the source columns in \a acceptColumns.
    TreeNodeSortFilterProxyModel(QSet<int> acceptColumns, int specialFlagsFilter,
                                 QObject *parent = nullptr);
    //! Destroys the proxy.
    ~TreeNodeSortFilterProxyModel() override;

    //! The filter mode given to the constructor (bits 1 and 2, see the class description).
    int specialFlagsFilter() const { return _specialFlagsFilter; }
    //! The source columns shown; empty means all.
    QSet<int> acceptColumns() const;
    //! Shows only the source columns in \a acceptColumns (all when empty), within one model reset.
    void setAcceptColumns(const QSet<int> &acceptColumns);

    TreeNode *rootNode() const override;
    TreeNode *toTreeNode(const QModelIndex &index) const override;
    TreeNode *toTreeNode(const QItemSelectionRange &range) const override;
    TreeNode *toTreeNode(const QItemSelection &selection) const override;
    QModelIndex treeNodeToIndex(TreeNode *node) const override;

protected:
    //! Accepts the columns of acceptColumns(), or every column when it is empty.
    bool filterAcceptsColumn(int sourceColumn, const QModelIndex &sourceParent) const override;
    //! Accepts a row by the special flags of its node (see the class description).
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;

    //! See specialFlagsFilter().
    int _specialFlagsFilter;
    //! See acceptColumns().
    QSet<int> _acceptColumns;
};

#endif // KVT_TREENODESORTFILTERPROXYMODEL_H
