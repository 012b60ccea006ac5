#ifndef KVT_MISCMODEL_H
#define KVT_MISCMODEL_H

#include "kvtcommon_export.h"

#include <QAbstractTableModel>
#include <QList>
#include <QString>

/*!
 * A one-column table of strings: each row shows its string as display text
 * and tool tip.
 */
class KVTCOMMON_EXPORT MiscModel : public QAbstractTableModel
{
    Q_OBJECT

public:
    explicit MiscModel(QObject *parent = nullptr);
    ~MiscModel() override;

    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    int columnCount(const QModelIndex &parent = QModelIndex()) const override;
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;
    Qt::ItemFlags flags(const QModelIndex &index) const override;
    using QAbstractTableModel::setData;

    //! The rows in order.
    QList<QString> data() const { return _data; }
    //! Replaces the rows in one model reset; an equal list changes nothing.
    void setData(const QList<QString> &data);
    //! Removes every row in one model reset.
    void clear();

protected:
    bool isRow(const QModelIndex &index) const;

    QList<QString> _data;
};

#endif // KVT_MISCMODEL_H
