// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "recordmodel.h"

#include "record.h"

#include <QSet>

RecordModel::RecordModel(ColumnCountFunction columnCount, HeaderFunction headerData,
                         CreateFunction create, QObject *parent)
    : QAbstractTableModel(parent)
    , _columnCountFunction(columnCount)
    , _headerFunction(headerData)
    , _createFunction(create)
    , _enabled(true)
{
}

RecordModel::~RecordModel()
{
    qDeleteAll(_records);
}

bool RecordModel::isCell(const QModelIndex &index) const
{
    return index.isValid() && index.model() == this && index.row() < _records.size()
           && index.column() < columnCount();
}

// The records of \a records that may be taken over: no null pointer, no
// record twice, none of those in \a held.
QList<Record *> RecordModel::newRecords(const QList<Record *> &records, const QList<Record *> &held) const
{
    QSet<Record *> seen;
    for (Record *record : held)
        seen.insert(record);
    QList<Record *> result;
    result.reserve(records.size());
    for (Record *record : records) {
        if (!record || seen.contains(record))
            continue;
        seen.insert(record);
        result.append(record);
    }
    return result;
}

bool RecordModel::isCreatable() const
{
    return _createFunction != nullptr;
}

QList<Record *> RecordModel::getRecordList() const
{
    return _records;
}

void RecordModel::setRecordList(const QList<Record *> &records)
{
    const QList<Record *> taken = newRecords(records, {});
    // A record given again (say, the model's own list with some additions)
    // stays alive; only the ones that leave the model are deleted.
    QSet<Record *> kept;
    for (Record *record : taken)
        kept.insert(record);
    beginResetModel();
    const QList<Record *> old = _records;
    _records = taken;
    for (Record *record : old) {
        if (!kept.contains(record))
            delete record;
    }
    endResetModel();
}

void RecordModel::appendRecordList(const QList<Record *> &records)
{
    const QList<Record *> taken = newRecords(records, _records);
    if (taken.isEmpty())
        return;
    // Empty rows at the bottom stay at the bottom.
    int position = _records.size();
    while (position > 0 && _records.at(position - 1)->isEmpty())
        --position;
    beginInsertRows(QModelIndex(), position, position + taken.size() - 1);
    for (int i = 0; i < taken.size(); ++i)
        _records.insert(position + i, taken.at(i));
    endInsertRows();
}

QList<Record *> RecordModel::takeRecordList()
{
    beginResetModel();
    QList<Record *> records;
    records.swap(_records);
    endResetModel();
    return records;
}

void RecordModel::clearRecordList()
{
    // Out of the list first: a record's destructor must not find itself in
    // the model.
    QList<Record *> records;
    records.swap(_records);
    qDeleteAll(records);
}

void RecordModel::clear()
{
    beginResetModel();
    clearRecordList();
    endResetModel();
}

bool RecordModel::allRecordsValid() const
{
    // An empty table is deliberately not a valid result.
    if (_records.isEmpty())
        return false;
    for (const Record *record : _records) {
        if (!record->isValid())
            return false;
    }
    return true;
}

void RecordModel::unchange()
{
    for (Record *record : qAsConst(_records))
        record->unchange();
}

bool RecordModel::isEnabled() const
{
    return _enabled;
}

void RecordModel::setEnabled(bool enabled)
{
    if (enabled == _enabled)
        return;
    // Every cell's flags change: the views start over.
    beginResetModel();
    _enabled = enabled;
    endResetModel();
}

int RecordModel::rowCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : _records.size();
}

int RecordModel::columnCount(const QModelIndex &parent) const
{
    if (parent.isValid() || !_columnCountFunction)
        return 0;
    return qMax(0, _columnCountFunction());
}

QVariant RecordModel::data(const QModelIndex &index, int role) const
{
    if (!isCell(index))
        return QVariant();
    return _records.at(index.row())->data(index.column(), role);
}

QVariant RecordModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (role != Qt::DisplayRole)
        return QAbstractTableModel::headerData(section, orientation, role);
    // Rows are numbered from 1.
    if (orientation == Qt::Vertical)
        return section + 1;
    // The module's function is only asked about its own columns.
    if (!_headerFunction || section < 0 || section >= columnCount())
        return QVariant();
    return _headerFunction(section);
}

Qt::ItemFlags RecordModel::flags(const QModelIndex &index) const
{
    Qt::ItemFlags flags = QAbstractTableModel::flags(index);
    if (_enabled && isCell(index) && _records.at(index.row())->isEditable(index.column()))
        flags |= Qt::ItemIsEditable;
    return flags;
}

bool RecordModel::setData(const QModelIndex &index, const QVariant &value, int role)
{
    if (!isCell(index) || role != Qt::EditRole)
        return false;
    const int row = index.row();
    if (!_records.at(row)->setData(index.column(), value))
        return false;
    // One cell can change how the others of its record look.
    Q_EMIT dataChanged(this->index(row, 0), this->index(row, columnCount() - 1), QVector<int>());
    return true;
}

bool RecordModel::insertRows(int row, int count, const QModelIndex &parent)
{
    if (!isCreatable() || parent.isValid() || count < 1 || row < 0 || row > _records.size())
        return false;
    // The records are made before the views hear of them, so a factory that
    // fails leaves the table as it was.
    QList<Record *> created;
    created.reserve(count);
    for (int i = 0; i < count; ++i) {
        Record *record = _createFunction();
        if (!record) {
            qDeleteAll(created);
            return false;
        }
        created.append(record);
    }
    beginInsertRows(QModelIndex(), row, row + count - 1);
    for (int i = 0; i < count; ++i)
        _records.insert(row + i, created.at(i));
    endInsertRows();
    return true;
}

bool RecordModel::removeRows(int row, int count, const QModelIndex &parent)
{
    if (parent.isValid() || count < 1 || row < 0 || row + count > _records.size())
        return false;
    beginRemoveRows(QModelIndex(), row, row + count - 1);
    for (int i = 0; i < count; ++i)
        delete _records.takeAt(row);
    endRemoveRows();
    return true;
}
