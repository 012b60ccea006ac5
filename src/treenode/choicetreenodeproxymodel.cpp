// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "choicetreenodeproxymodel.h"

#include "treenodeproxyhelper_p.h"

ChoiceTreeNodeProxyModel::ChoiceTreeNodeProxyModel(int nameColumn, int choiceRole, int blockRole,
                                                   QObject *parent)
    : QIdentityProxyModel(parent)
    , _nameColumn(nameColumn)
    , _choiceRole(choiceRole)
    , _blockRole(blockRole)
{
}

ChoiceTreeNodeProxyModel::~ChoiceTreeNodeProxyModel() = default;

void ChoiceTreeNodeProxyModel::setCheckedBlockedNames(QSet<QString> checked, QSet<QString> blocked)
{
    if (checked == _checkedNames && blocked == _blockedNames)
        return;
    beginResetModel();
    _checkedNames = std::move(checked);
    _blockedNames = std::move(blocked);
    _addNames.clear();
    _removeNames.clear();
    endResetModel();
    Q_EMIT stateChanged();
}

void ChoiceTreeNodeProxyModel::setCheckedNames(QSet<QString> checked)
{
    if (checked == _checkedNames)
        return;
    beginResetModel();
    _checkedNames = std::move(checked);
    _addNames.clear();
    _removeNames.clear();
    endResetModel();
    Q_EMIT stateChanged();
}

void ChoiceTreeNodeProxyModel::setBlockedNames(QSet<QString> blocked)
{
    if (blocked == _blockedNames)
        return;
    // Blocking changes what may be edited, not what was edited: the add and
    // remove sets stay.
    beginResetModel();
    _blockedNames = std::move(blocked);
    endResetModel();
    Q_EMIT stateChanged();
}

void ChoiceTreeNodeProxyModel::clearAddRemoveNames()
{
    _addNames.clear();
    _removeNames.clear();
}

QString ChoiceTreeNodeProxyModel::nameOf(const QModelIndex &index) const
{
    const QModelIndex sourceIndex = mapToSource(index);
    const QModelIndex nameIndex = sourceModel()->index(sourceIndex.row(), _nameColumn, sourceIndex.parent());
    return nameIndex.data(Qt::DisplayRole).toString();
}

bool ChoiceTreeNodeProxyModel::isTicked(const QModelIndex &index) const
{
    const QString name = nameOf(index);
    if (!_blockedNames.contains(name))
        return _checkedNames.contains(name);
    // A blocked name follows its nearest ancestor that the user may change;
    // a row blocked all the way up counts as ticked.
    for (QModelIndex ancestor = index.parent(); ancestor.isValid(); ancestor = ancestor.parent()) {
        const QString ancestorName = nameOf(ancestor);
        if (!_blockedNames.contains(ancestorName))
            return _checkedNames.contains(ancestorName);
    }
    return true;
}

QVariant ChoiceTreeNodeProxyModel::data(const QModelIndex &index, int role) const
{
    if (!sourceModel() || !index.isValid() || index.model() != this)
        return QVariant();
    if ((role == _choiceRole || role == _blockRole) && index.column() == _nameColumn) {
        const bool ticked = isTicked(index);
        // Views read a check state as an int; true would read as partially
        // checked.
        if (role == Qt::CheckStateRole)
            return int(ticked ? Qt::Checked : Qt::Unchecked);
        return ticked;
    }
    return QIdentityProxyModel::data(index, role);
}

bool ChoiceTreeNodeProxyModel::setData(const QModelIndex &index, const QVariant &value, int role)
{
    if (!TreeNodeProxyHelper::extension(sourceModel()) || !index.isValid() || index.model() != this)
        return false;
    if (role != _choiceRole || index.column() != _nameColumn)
        return QIdentityProxyModel::setData(index, value, role);

    const QString name = nameOf(index);
    if (_blockedNames.contains(name))
        return false;
    const bool tick = value.toBool();
    if (tick == _checkedNames.contains(name))
        return false;

    if (tick) {
        _checkedNames.insert(name);
        if (!_removeNames.remove(name))
            _addNames.insert(name);
    } else {
        if (!_addNames.remove(name))
            _removeNames.insert(name);
        _checkedNames.remove(name);
    }
    Q_EMIT dataChanged(index, index, QVector<int>());
    Q_EMIT stateChanged();
    return true;
}

Qt::ItemFlags ChoiceTreeNodeProxyModel::flags(const QModelIndex &index) const
{
    if (!sourceModel() || !index.isValid())
        return QIdentityProxyModel::flags(index);
    if (index.model() != this)
        return Qt::NoItemFlags;
    // A blocked row is neither enabled nor selectable, in every column.
    if (_blockedNames.contains(nameOf(index)))
        return Qt::NoItemFlags;
    return QIdentityProxyModel::flags(index);
}

TreeNode *ChoiceTreeNodeProxyModel::rootNode() const
{
    return TreeNodeProxyHelper::rootNode(this);
}

TreeNode *ChoiceTreeNodeProxyModel::toTreeNode(const QModelIndex &index) const
{
    return TreeNodeProxyHelper::toTreeNode(this, index);
}

TreeNode *ChoiceTreeNodeProxyModel::toTreeNode(const QItemSelectionRange &range) const
{
    return TreeNodeProxyHelper::toTreeNode(this, range);
}

TreeNode *ChoiceTreeNodeProxyModel::toTreeNode(const QItemSelection &selection) const
{
    return TreeNodeProxyHelper::toTreeNode(this, selection);
}

QModelIndex ChoiceTreeNodeProxyModel::treeNodeToIndex(TreeNode *node) const
{
    return TreeNodeProxyHelper::treeNodeToIndex(this, node);
}
