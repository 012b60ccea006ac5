// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "treenodemodel.h"

#include "treenode.h"

namespace {

const int leafSpecialFlag = 4;

} // namespace

TreeNodeModel::TreeNodeModel(QObject *parent)
    : TreeNodeModel(nullptr, parent)
{
}

TreeNodeModel::TreeNodeModel(TreeNode *root, QObject *parent)
    : QAbstractItemModel(parent)
    , _rootNode(nullptr)
{
    if (root) {
        _rootNode = root;
        connectVertexNode(root);
    }
}

TreeNodeModel::~TreeNodeModel() = default;

QModelIndex TreeNodeModel::index(int row, int column, const QModelIndex &parent) const
{
    if (!_rootNode || row < 0 || column < 0)
        return QModelIndex();
    TreeNode *parentNode = toTreeNode(parent);
    if (!parentNode || row >= rowCount(parent) || column >= columnCount(parent))
        return QModelIndex();
    return createIndex(row, column, parentNode);
}

QModelIndex TreeNodeModel::parent(const QModelIndex &index) const
{
    if (!_rootNode || !index.isValid() || index.model() != this)
        return QModelIndex();
    return treeNodeToIndex(static_cast<TreeNode *>(index.internalPointer()));
}

int TreeNodeModel::rowCount(const QModelIndex &parent) const
{
    // Children hang off column 0 only, as views expect; otherwise every
    // column of a row would repeat the same children.
    if (!_rootNode || parent.column() > 0)
        return 0;
    const TreeNode *node = toTreeNode(parent);
    if (!node)
        return 0;
    int rows = node->childNodesCount();
    if (node == _rootNode)
        rows += _extraRootChildNodes.size();
    return rows;
}

int TreeNodeModel::columnCount(const QModelIndex &) const
{
    // Every level of the tree has the root's columns.
    return _rootNode ? _rootNode->columnCount() : 0;
}

bool TreeNodeModel::hasChildren(const QModelIndex &parent) const
{
    if (!_rootNode)
        return false;
    if (rowCount(parent) == 0 && !canFetchMore(parent))
        return false;
    const TreeNode *node = toTreeNode(parent);
    if (!node)
        return true;
    // A node may declare itself a leaf: it never shows an expander, even
    // while it holds children.
    return !(node->treeNodeSpecialFlags() & leafSpecialFlag);
}

QVariant TreeNodeModel::data(const QModelIndex &index, int role) const
{
    if (!_rootNode || !index.isValid())
        return QVariant();
    const TreeNode *node = toTreeNode(index);
    return node ? node->data(index.column(), role) : QVariant();
}

bool TreeNodeModel::setData(const QModelIndex &index, const QVariant &value, int role)
{
    if (!_rootNode || !index.isValid())
        return false;
    TreeNode *node = toTreeNode(index);
    if (!node)
        return false;
    const bool accepted = node->setData(index.column(), value, role);
    if (accepted)
        Q_EMIT dataChanged(index, index, QVector<int>());
    return accepted;
}

QVariant TreeNodeModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    return _rootNode ? _rootNode->headerData(section, orientation, role) : QVariant();
}

void TreeNodeModel::fetchMore(const QModelIndex &parent)
{
    if (!_rootNode)
        return;
    if (TreeNode *node = toTreeNode(parent))
        node->fetchMore();
}

bool TreeNodeModel::canFetchMore(const QModelIndex &parent) const
{
    // Any column of a row asks that row's node.
    if (!_rootNode)
        return false;
    const TreeNode *node = toTreeNode(parent);
    return node && node->canFetchMore();
}

Qt::ItemFlags TreeNodeModel::flags(const QModelIndex &index) const
{
    if (!_rootNode || !index.isValid())
        return Qt::NoItemFlags;
    const TreeNode *node = toTreeNode(index);
    return node ? node->flags(index.column()) : Qt::NoItemFlags;
}

TreeNode *TreeNodeModel::rootNode() const
{
    return _rootNode;
}

TreeNode *TreeNodeModel::toTreeNode(const QModelIndex &index) const
{
    if (!_rootNode)
        return nullptr;
    if (index.row() < 0 || index.column() < 0 || !index.model())
        return _rootNode;
    if (index.model() != this)
        return nullptr;

    const TreeNode *parent = static_cast<const TreeNode *>(index.internalPointer());
    int row = index.row();
    if (parent == _rootNode) {
        if (row < _extraRootChildNodes.size())
            return _extraRootChildNodes.at(row);
        row -= _extraRootChildNodes.size();
    }
    const QList<TreeNode *> &children = parent->childNodes();
    return row < children.size() ? children.at(row) : nullptr;
}

TreeNode *TreeNodeModel::toTreeNode(const QItemSelectionRange &range) const
{
    if (!_rootNode || range.model() != this)
        return nullptr;
    const QModelIndexList indexes = range.indexes();
    for (const QModelIndex &index : indexes) {
        if (TreeNode *node = toTreeNode(index))
            return node;
    }
    return nullptr;
}

TreeNode *TreeNodeModel::toTreeNode(const QItemSelection &selection) const
{
    if (!_rootNode)
        return nullptr;
    for (const QItemSelectionRange &range : selection) {
        if (TreeNode *node = toTreeNode(range))
            return node;
    }
    return nullptr;
}

QModelIndex TreeNodeModel::treeNodeToIndex(TreeNode *node) const
{
    if (!_rootNode || !node || node == _rootNode)
        return QModelIndex();
    const int extraRow = _extraRootChildNodes.indexOf(node);
    if (extraRow >= 0)
        return createIndex(extraRow, 0, _rootNode);

    // The node must hang below the root; the children of an extra node count
    // as part of the shown tree too.
    TreeNode *ancestor = node->parentNode();
    while (ancestor && ancestor != _rootNode && !_extraRootChildNodes.contains(ancestor))
        ancestor = ancestor->parentNode();
    if (!ancestor)
        return QModelIndex();

    TreeNode *parent = node->parentNode();
    int row = node->row();
    if (row < 0)
        return QModelIndex();
    if (parent == _rootNode)
        row += _extraRootChildNodes.size();
    return createIndex(row, 0, parent);
}

void TreeNodeModel::setRootNode(TreeNode *node)
{
    if (node == _rootNode)
        return;
    disconnectVertexNode(_rootNode);
    beginResetModel();
    _rootNode = node;
    endResetModel();
    connectVertexNode(_rootNode);
}

QList<TreeNode *> TreeNodeModel::extraRootChildNodes() const
{
    return _extraRootChildNodes;
}

void TreeNodeModel::setExtraRootChildNodes(const QList<TreeNode *> &nodes)
{
    if (&nodes == &_extraRootChildNodes)
        return;
    beginResetModel();
    for (TreeNode *node : qAsConst(_extraRootChildNodes))
        disconnectVertexNode(node);
    _extraRootChildNodes = nodes;
    for (TreeNode *node : qAsConst(_extraRootChildNodes))
        connectVertexNode(node);
    endResetModel();
}

void TreeNodeModel::deleteExtraRootChildNodes()
{
    if (_extraRootChildNodes.isEmpty())
        return;
    beginResetModel();
    const QList<TreeNode *> extras = _extraRootChildNodes;
    _extraRootChildNodes.clear();
    for (TreeNode *node : extras) {
        disconnectVertexNode(node);
        delete node;
    }
    endResetModel();
}

void TreeNodeModel::connectVertexNode(TreeNode *node)
{
    if (!node)
        return;
    connect(node, SIGNAL(nodesAboutToBeInserted(TreeNode*,int,int)),
            this, SLOT(nodesAboutToBeInserted(TreeNode*,int,int)));
    connect(node, SIGNAL(nodesAboutToBeRemoved(TreeNode*,int,int)),
            this, SLOT(nodesAboutToBeRemoved(TreeNode*,int,int)));
    connect(node, SIGNAL(nodesInserted()), this, SLOT(nodesInserted()));
    connect(node, SIGNAL(nodesRemoved()), this, SLOT(nodesRemoved()));
    connect(node, SIGNAL(nodeDataChanged(TreeNode*)), this, SLOT(nodeDataChanged(TreeNode*)));
    connect(node, SIGNAL(nodeChildsDataChanged(TreeNode*)),
            this, SLOT(nodeChildsDataChanged(TreeNode*)));

    // A root or extra node destroyed while shown must not leave the model
    // pointing at it: the model then forgets the node in one reset.
    connect(node, &QObject::destroyed, this, [this, node] {
        // Only pointers are compared here: the node is no longer a TreeNode.
        beginResetModel();
        if (node == _rootNode)
            _rootNode = nullptr;
        _extraRootChildNodes.removeAll(node);
        endResetModel();
    });
}

void TreeNodeModel::disconnectVertexNode(TreeNode *node)
{
    if (!node)
        return;
    disconnect(node, SIGNAL(nodesAboutToBeInserted(TreeNode*,int,int)),
               this, SLOT(nodesAboutToBeInserted(TreeNode*,int,int)));
    disconnect(node, SIGNAL(nodesAboutToBeRemoved(TreeNode*,int,int)),
               this, SLOT(nodesAboutToBeRemoved(TreeNode*,int,int)));
    disconnect(node, SIGNAL(nodesInserted()), this, SLOT(nodesInserted()));
    disconnect(node, SIGNAL(nodesRemoved()), this, SLOT(nodesRemoved()));
    disconnect(node, SIGNAL(nodeDataChanged(TreeNode*)), this, SLOT(nodeDataChanged(TreeNode*)));
    disconnect(node, SIGNAL(nodeChildsDataChanged(TreeNode*)),
               this, SLOT(nodeChildsDataChanged(TreeNode*)));
    disconnect(node, &QObject::destroyed, this, nullptr);
}

void TreeNodeModel::nodesAboutToBeReset()
{
    if (!_rootNode)
        return;
    beginResetModel();
    // Whatever the tree does until nodesReset() reaches no view: a whole
    // reload is shown as this one reset.
    blockSignals(true);
}

void TreeNodeModel::nodesReset()
{
    if (!_rootNode)
        return;
    blockSignals(false);
    endResetModel();
}

void TreeNodeModel::nodesAboutToBeInserted(TreeNode *parent, int first, int last)
{
    if (!_rootNode)
        return;
    if (parent == _rootNode) {
        first += _extraRootChildNodes.size();
        last += _extraRootChildNodes.size();
    }
    beginInsertRows(treeNodeToIndex(parent), first, last);
}

void TreeNodeModel::nodesAboutToBeRemoved(TreeNode *parent, int first, int last)
{
    if (!_rootNode)
        return;
    if (parent == _rootNode) {
        first += _extraRootChildNodes.size();
        last += _extraRootChildNodes.size();
    }
    beginRemoveRows(treeNodeToIndex(parent), first, last);
}

void TreeNodeModel::nodesInserted()
{
    if (_rootNode)
        endInsertRows();
}

void TreeNodeModel::nodesRemoved()
{
    if (_rootNode)
        endRemoveRows();
}

void TreeNodeModel::nodeDataChanged(TreeNode *node)
{
    if (!_rootNode)
        return;
    const int columns = columnCount();
    if (columns <= 0)
        return;
    const QModelIndex left = treeNodeToIndex(node);
    QModelIndex right;
    if (left.isValid())
        right = left.column() == columns - 1 ? left : createIndex(left.row(), columns - 1, left.internalPointer());
    // The root has no index of its own: its change is announced with two
    // invalid indexes, which views take as "repaint everything".
    Q_EMIT dataChanged(left, right, QVector<int>());
}

void TreeNodeModel::nodeChildsDataChanged(TreeNode *node)
{
    if (!_rootNode || !node)
        return;
    int rows = node->childNodesCount();
    if (node == _rootNode)
        rows += _extraRootChildNodes.size();
    const int columns = columnCount();
    if (rows == 0 || columns <= 0)
        return;
    const QModelIndex parent = treeNodeToIndex(node);
    if (node != _rootNode && !parent.isValid())
        return;
    Q_EMIT dataChanged(index(0, 0, parent), index(rows - 1, columns - 1, parent), QVector<int>());
}
