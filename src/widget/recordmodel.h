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
    using ColumnCountFunction = int (*)();
    using HeaderFunction = QVariant (*)(int);
    using CreateFunction = Record *(*)();

    RecordModel(ColumnCountFunction columnCount, HeaderFunction headerData, CreateFunction create,
                QObject *parent = nullptr);
    ~RecordModel() override;

    //! Whether rows can be inserted: the model has a factory of records.
    bool isCreatable() const;
    //! The records; they stay owned by the model.
    QList<Record *> getRecordList() const;
    void setRecordList(const QList<Record *> &records);
    void appendRecordList(const QList<Record *> &records);
    //! Empties the model and hands its records to the caller, who then owns them.
    QList<Record *> takeRecordList();
    //! Deletes every record without telling the views: only for use inside a
    //! model reset.
    void clearRecordList();
    void clear();
    //! True when there is at least one record and every record is valid.
    bool allRecordsValid() const;
    void unchange();
    bool isEnabled() const;
    void setEnabled(bool enabled);

    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    int columnCount(const QModelIndex &parent = QModelIndex()) const override;
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;
    Qt::ItemFlags flags(const QModelIndex &index) const override;
    bool setData(const QModelIndex &index, const QVariant &value, int role = Qt::EditRole) override;
    bool insertRows(int row, int count, const QModelIndex &parent = QModelIndex()) override;
    bool removeRows(int row, int count, const QModelIndex &parent = QModelIndex()) override;

protected:
    QList<Record *> _records;
    ColumnCountFunction _columnCountFunction;
    HeaderFunction _headerFunction;
    CreateFunction _createFunction;
    bool _enabled;

private:
    bool isCell(const QModelIndex &index) const;
    QList<Record *> newRecords(const QList<Record *> &records, const QList<Record *> &held) const;
};

#endif // KVT_RECORDMODEL_H
