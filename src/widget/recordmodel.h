// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_RECORDMODEL_H
#define KVT_RECORDMODEL_H

#include "kvtcommon_export.h"

#include <QAbstractTableModel>
#include <QList>

class Record;

/*!
 * A table whose rows are Record objects of one type, described by three plain
 * functions of the module: the number of columns, the horizontal header of a
 * column, and a factory of new empty records.
 *
 * The model owns every record it holds, from the moment it is given one
 * (setRecordList(), appendRecordList()) or creates one (insertRows()) until it
 * deletes it (removeRows(), clear(), clearRecordList(), setRecordList(), the
 * destructor) or hands it back (takeRecordList()). Null pointers and records
 * the model already holds are ignored when records are handed over, so a
 * record is never deleted twice.
 *
 * Records appended to the table go above the empty rows at its bottom.
 */
class KVTCOMMON_EXPORT RecordModel : public QAbstractTableModel
{
    Q_OBJECT

public:
    //! The number of columns of the record type.
    using ColumnCountFunction = int (*)();
    //! The horizontal header text of a column.
    using HeaderFunction = QVariant (*)(int);
    //! A factory of new empty records; may be null when rows cannot be inserted.
    using CreateFunction = Record *(*)();

    //! Creates an empty, enabled model of the record type the three functions describe.
    RecordModel(ColumnCountFunction columnCount, HeaderFunction headerData, CreateFunction create,
                QObject *parent = nullptr);
    //! Deletes every record held.
    ~RecordModel() override;

    //! Whether rows can be inserted: the model has a factory of records.
    bool isCreatable() const;
    //! The records; they stay owned by the model.
    QList<Record *> getRecordList() const;
    /*!
     * Replaces the rows by \a records in one model reset; the old records are deleted, the new ones owned.
     */
    void setRecordList(const QList<Record *> &records);
    //! Adds \a records (now owned) above the empty rows at the bottom.
    void appendRecordList(const QList<Record *> &records);
    //! Empties the model and hands its records to the caller, who then owns them.
    QList<Record *> takeRecordList();
    //! Deletes every record without telling the views: only for use inside a
    //! model reset.
    void clearRecordList();
    //! Deletes every record in one model reset.
    void clear();
    //! True when there is at least one record and every record is valid.
    bool allRecordsValid() const;
    //! Marks every record unchanged.
    void unchange();
    //! Whether the cells can be edited.
    bool isEnabled() const;
    //! Allows or forbids editing; views follow at once.
    void setEnabled(bool enabled);

    //! One row per record.
    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    //! The column count of the record type.
    int columnCount(const QModelIndex &parent = QModelIndex()) const override;
    //! The record's Record::data() for the cell.
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    //! The header function's text for horizontal sections.
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;
    //! Editable cells while the model is enabled and the record allows it.
    Qt::ItemFlags flags(const QModelIndex &index) const override;
    //! Hands the edit to Record::setData() and announces the change when accepted.
    bool setData(const QModelIndex &index, const QVariant &value, int role = Qt::EditRole) override;
    //! Inserts \a count new empty records from the factory; false without one.
    bool insertRows(int row, int count, const QModelIndex &parent = QModelIndex()) override;
    //! Deletes \a count records from \a row on.
    bool removeRows(int row, int count, const QModelIndex &parent = QModelIndex()) override;

protected:
    //! The records, owned.
    QList<Record *> _records;
    //! See ColumnCountFunction.
    ColumnCountFunction _columnCountFunction;
    //! See HeaderFunction.
    HeaderFunction _headerFunction;
    //! See CreateFunction.
    CreateFunction _createFunction;
    //! See isEnabled().
    bool _enabled;

private:
    bool isCell(const QModelIndex &index) const;
    QList<Record *> newRecords(const QList<Record *> &records, const QList<Record *> &held) const;
};

#endif // KVT_RECORDMODEL_H
