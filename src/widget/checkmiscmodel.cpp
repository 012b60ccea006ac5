// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "checkmiscmodel.h"

CheckMiscModel::CheckMiscModel(QObject *parent)
    : MiscModel(parent)
{
}

CheckMiscModel::~CheckMiscModel() = default;

bool CheckMiscModel::isChecked(int row) const
{
    // The strings may have been replaced through MiscModel::setData(), which
    // knows nothing of the flags: a row without a flag is not ticked.
    return row >= 0 && row < _checked.size() && _checked.at(row);
}

QVariant CheckMiscModel::data(const QModelIndex &index, int role) const
{
    if (!isRow(index))
        return QVariant();
    if (role == Qt::CheckStateRole)
        return int(isChecked(index.row()) ? Qt::Checked : Qt::Unchecked);
    return MiscModel::data(index, role);
}

Qt::ItemFlags CheckMiscModel::flags(const QModelIndex &index) const
{
    const Qt::ItemFlags flags = MiscModel::flags(index);
    return flags ? flags | Qt::ItemIsUserCheckable : flags;
}

bool CheckMiscModel::setData(const QModelIndex &index, const QVariant &value, int role)
{
    if (!changeCheckState(index, value, role))
        return false;
    Q_EMIT dataChanged(index, index);
    return true;
}

bool CheckMiscModel::changeCheckState(const QModelIndex &index, const QVariant &value, int role)
{
    if (!isRow(index) || role != Qt::CheckStateRole)
        return false;
    const int row = index.row();
    const bool ticked = value.toInt() == Qt::Checked;
    if (ticked == isChecked(row))
        return false;
    while (_checked.size() <= row)
        _checked.append(false);
    _checked[row] = ticked;

    // The sets are brought up to date before anyone is told of the change,
    // so a listener already reads the new state.
    const QString &text = _data.at(row);
    if (ticked) {
        if (!_dataToRemove.remove(text))
            _dataToAdd.insert(text);
    } else {
        if (!_dataToAdd.remove(text))
            _dataToRemove.insert(text);
    }
    return true;
}

void CheckMiscModel::load(const QList<QString> &list, const QSet<QString> &set, bool tickedWhenInSet)
{
    beginResetModel();
    // Views hear of the whole load as this one reset.
    const bool blocked = blockSignals(true);
    MiscModel::setData(list);
    _checked.clear();
    _checked.reserve(_data.size());
    for (const QString &text : qAsConst(_data))
        _checked.append(set.contains(text) == tickedWhenInSet);
    _dataToAdd.clear();
    _dataToRemove.clear();
    blockSignals(blocked);
    endResetModel();
}

void CheckMiscModel::setData(const QList<QString> &data)
{
    load(data, QSet<QString>(), true);
}

void CheckMiscModel::setDataChecked(const QList<QString> &list, const QSet<QString> &set)
{
    load(list, set, true);
}

void CheckMiscModel::setDataUnchecked(const QList<QString> &list, const QSet<QString> &set)
{
    load(list, set, false);
}

void CheckMiscModel::clear()
{
    _dataToAdd.clear();
    _dataToRemove.clear();
    if (_data.isEmpty()) {
        _checked.clear();
        return;
    }
    beginResetModel();
    _data.clear();
    _checked.clear();
    endResetModel();
}

QSet<QString> CheckMiscModel::checkedData() const
{
    QSet<QString> result;
    for (int row = 0; row < _data.size(); ++row) {
        if (isChecked(row))
            result.insert(_data.at(row));
    }
    return result;
}

QSet<QString> CheckMiscModel::uncheckedData() const
{
    QSet<QString> result;
    for (int row = 0; row < _data.size(); ++row) {
        if (!isChecked(row))
            result.insert(_data.at(row));
    }
    return result;
}
