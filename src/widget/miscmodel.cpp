// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "miscmodel.h"

MiscModel::MiscModel(QObject *parent)
    : QAbstractTableModel(parent)
{
}

MiscModel::~MiscModel() = default;

bool MiscModel::isRow(const QModelIndex &index) const
{
    return index.isValid() && index.model() == this && index.column() == 0 && index.row() >= 0
           && index.row() < _data.size();
}

int MiscModel::rowCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : _data.size();
}

int MiscModel::columnCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : 1;
}

QVariant MiscModel::data(const QModelIndex &index, int role) const
{
    if (!isRow(index) || (role != Qt::DisplayRole && role != Qt::ToolTipRole))
        return QVariant();
    return _data.at(index.row());
}

QVariant MiscModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (section == 0 && orientation == Qt::Horizontal && role == Qt::DisplayRole)
        return tr("Data");
    return QVariant();
}

Qt::ItemFlags MiscModel::flags(const QModelIndex &index) const
{
    if (!index.isValid())
        return QAbstractTableModel::flags(index);
    return Qt::ItemIsSelectable | Qt::ItemIsEnabled | Qt::ItemNeverHasChildren;
}

void MiscModel::setData(const QList<QString> &data)
{
    if (data == _data)
        return;
    beginResetModel();
    _data = data;
    endResetModel();
}

void MiscModel::clear()
{
    beginResetModel();
    _data.clear();
    endResetModel();
}
