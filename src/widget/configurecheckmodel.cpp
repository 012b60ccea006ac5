// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "configurecheckmodel.h"

ConfigureCheckModel::ConfigureCheckModel(QObject *parent)
    : CheckMiscModel(parent)
{
}

ConfigureCheckModel::~ConfigureCheckModel() = default;

void ConfigureCheckModel::setInCmpatibleModes(const QSet<int> &modes)
{
    if (modes == _inCmpatibleModes)
        return;
    beginResetModel();
    _inCmpatibleModes = modes;
    endResetModel();
}

void ConfigureCheckModel::setDescriptions(const QStringList &descriptions)
{
    if (descriptions != _descriptions)
        _descriptions = descriptions;
}

bool ConfigureCheckModel::checkCompatible(int a, int b) const
{
    const int n = _data.size();
    if (a < 0 || b < 0 || a >= n || b >= n)
        return false;
    if (a == b)
        return true;
    return !_inCmpatibleModes.contains(qMin(a, b) * n + qMax(a, b));
}

bool ConfigureCheckModel::isExcluded(int row) const
{
    if (_inCmpatibleModes.isEmpty())
        return false;
    for (int ticked = 0; ticked < _data.size(); ++ticked) {
        if (isChecked(ticked) && !checkCompatible(ticked, row))
            return true;
    }
    return false;
}

QVariant ConfigureCheckModel::data(const QModelIndex &index, int role) const
{
    if (!isRow(index))
        return QVariant();
    switch (role) {
    case Qt::UserRole:
        return index.row() < _descriptions.size() ? QVariant(_descriptions.at(index.row())) : QVariant();
    case Qt::CheckStateRole:
        // An excluded row shows no check box at all.
        return isExcluded(index.row()) ? QVariant() : CheckMiscModel::data(index, role);
    case Qt::DisplayRole:
    case Qt::ToolTipRole:
        return CheckMiscModel::data(index, role);
    default:
        return QVariant();
    }
}

Qt::ItemFlags ConfigureCheckModel::flags(const QModelIndex &index) const
{
    Qt::ItemFlags flags = CheckMiscModel::flags(index);
    if (isRow(index) && isExcluded(index.row()))
        flags &= ~(Qt::ItemIsUserCheckable | Qt::ItemIsEnabled);
    return flags;
}

bool ConfigureCheckModel::setData(const QModelIndex &index, const QVariant &value, int role)
{
    // A row excluded by a ticked one is disabled in views, but the model
    // itself still takes the change, as a plain check model would: the
    // caller decides.
    if (!changeCheckState(index, value, role))
        return false;
    // Ticking or unticking one row can enable or disable any other.
    Q_EMIT dataChanged(index.sibling(0, 0), index.sibling(_data.size() - 1, 0));
    return true;
}
