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
    explicit TreeNodeModel(QObject *parent = nullptr);
    explicit TreeNodeModel(TreeNode *root, QObject *parent = nullptr);
    ~TreeNodeModel() override;

    QModelIndex index(int row, int column, const QModelIndex &parent = QModelIndex()) const override;
    QModelIndex parent(const QModelIndex &index) const override;
    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    int columnCount(const QModelIndex &parent = QModelIndex()) const override;
    bool hasChildren(const QModelIndex &parent = QModelIndex()) const override;
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    bool setData(const QModelIndex &index, const QVariant &value, int role = Qt::EditRole) override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;
    void fetchMore(const QModelIndex &parent) override;
    bool canFetchMore(const QModelIndex &parent) const override;
    Qt::ItemFlags flags(const QModelIndex &index) const override;

    TreeNode *rootNode() const override;
    TreeNode *toTreeNode(const QModelIndex &index) const override;
    TreeNode *toTreeNode(const QItemSelectionRange &range) const override;
    TreeNode *toTreeNode(const QItemSelection &selection) const override;
    QModelIndex treeNodeToIndex(TreeNode *node) const override;

    void setRootNode(TreeNode *node);
    QList<TreeNode *> extraRootChildNodes() const;
    void setExtraRootChildNodes(const QList<TreeNode *> &nodes);
    void deleteExtraRootChildNodes();
    void connectVertexNode(TreeNode *node);
    void disconnectVertexNode(TreeNode *node);

public Q_SLOTS:
    void nodesAboutToBeReset();
    void nodesReset();
    void nodesAboutToBeInserted(TreeNode *parent, int first, int last);
    void nodesAboutToBeRemoved(TreeNode *parent, int first, int last);
    void nodesInserted();
    void nodesRemoved();
    void nodeDataChanged(TreeNode *node);
    void nodeChildsDataChanged(TreeNode *node);

protected:
    TreeNode *_rootNode;
    QList<TreeNode *> _extraRootChildNodes;
};

#endif // KVT_TREENODEMODEL_H
