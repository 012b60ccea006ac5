// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TREENODEMODEL_H
#define KVT_TREENODEMODEL_H

#include "treenodemodelextension.h"

#include <QAbstractItemModel>
#include <QList>

class TreeNode;

/*!
 * The item model that shows any TreeNode tree.
 *
 * The model listens to the root only; the nodes' signal forwarding brings
 * every change of the tree there. Extra nodes that are not part of the tree
 * can be shown as the first rows under the root.
 *
 * An index's internal pointer is the parent node of its row, not the node
 * itself, so every index can be resolved through its parent's child list.
 * The model never owns the tree.
 */
class KVTCOMMON_EXPORT TreeNodeModel : public QAbstractItemModel, public virtual TreeNodeModelExtension
{
    Q_OBJECT

public:
    //! Creates an empty model; give it a tree with setRootNode().
    explicit TreeNodeModel(QObject *parent = nullptr);
    /*!
     * Creates a model of the tree under \a root (may be null). The root must
     * outlive the model, or be replaced with setRootNode() before it is destroyed.
     */
    explicit TreeNodeModel(TreeNode *root, QObject *parent = nullptr);
    //! Destroys the model; the tree and the extra nodes are left alone.
    ~TreeNodeModel() override;

    //! The index of \a row and \a column under \a parent; invalid when out of range.
    QModelIndex index(int row, int column, const QModelIndex &parent = QModelIndex()) const override;
    //! The index of the node holding the row of \a index.
    QModelIndex parent(const QModelIndex &index) const override;
    //! Children of the node of \a parent; under the root the extra nodes count too.
    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    //! The root's TreeNode::columnCount(), whatever \a parent is.
    int columnCount(const QModelIndex &parent = QModelIndex()) const override;
    /*!
     * Whether \a parent has rows or can fetch some. A node whose special flags have
     * bit 4 set never shows an expander.
     */
    bool hasChildren(const QModelIndex &parent = QModelIndex()) const override;
    //! The node's TreeNode::data() for the column of \a index.
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    /*!
     * Passes the edit to the node's TreeNode::setData() and emits dataChanged()
     * for \a index when the node accepts it.
     */
    bool setData(const QModelIndex &index, const QVariant &value, int role = Qt::EditRole) override;
    //! The root's TreeNode::headerData().
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;
    //! Asks the node of \a parent to read its children (TreeNode::fetchMore()).
    void fetchMore(const QModelIndex &parent) override;
    //! The TreeNode::canFetchMore() of the node of \a parent.
    bool canFetchMore(const QModelIndex &parent) const override;
    //! The node's TreeNode::flags() for the column of \a index.
    Qt::ItemFlags flags(const QModelIndex &index) const override;

    TreeNode *rootNode() const override;
    TreeNode *toTreeNode(const QModelIndex &index) const override;
    TreeNode *toTreeNode(const QItemSelectionRange &range) const override;
    TreeNode *toTreeNode(const QItemSelection &selection) const override;
    QModelIndex treeNodeToIndex(TreeNode *node) const override;

    //! Shows the tree under \a node instead, within one model reset. Null empties the model.
    void setRootNode(TreeNode *node);
    //! The nodes shown as the first rows under the root, before its own children.
    QList<TreeNode *> extraRootChildNodes() const;
    /*!
     * Shows \a nodes as the first rows under the root, within one model reset. The
     * model listens to their signals but does not own them; see
     * deleteExtraRootChildNodes().
     */
    void setExtraRootChildNodes(const QList<TreeNode *> &nodes);
    //! Destroys the extra root rows and empties their list, within one model reset.
    void deleteExtraRootChildNodes();
    /*!
     * Connects the six change signals of \a node (insertion, removal, data) to the
     * slots of the model. The model does so for its root and extra nodes.
     */
    void connectVertexNode(TreeNode *node);
    //! Undoes connectVertexNode().
    void disconnectVertexNode(TreeNode *node);

public Q_SLOTS:
    /*!
     * Begins a model reset and holds back the model's signals until nodesReset(),
     * so that a whole reload of the tree reaches views as one reset. Containers
     * connect their about-to-be-reset signal here.
     */
    void nodesAboutToBeReset();
    //! Ends the reset begun by nodesAboutToBeReset().
    void nodesReset();
    //! Turns TreeNode::nodesAboutToBeInserted() into beginInsertRows().
    void nodesAboutToBeInserted(TreeNode *parent, int first, int last);
    //! Turns TreeNode::nodesAboutToBeRemoved() into beginRemoveRows().
    void nodesAboutToBeRemoved(TreeNode *parent, int first, int last);
    //! Ends the insertion announced last.
    void nodesInserted();
    //! Ends the removal announced last.
    void nodesRemoved();
    //! Emits dataChanged() over all columns of the row of \a node.
    void nodeDataChanged(TreeNode *node);
    //! Emits dataChanged() over all rows and columns under \a node.
    void nodeChildsDataChanged(TreeNode *node);

protected:
    //! The root shown; not owned.
    TreeNode *_rootNode;
    //! See extraRootChildNodes().
    QList<TreeNode *> _extraRootChildNodes;
};

#endif // KVT_TREENODEMODEL_H
