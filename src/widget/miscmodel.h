// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    //! Creates an empty model.
    explicit MiscModel(QObject *parent = nullptr);
    //! Destroys the model.
    ~MiscModel() override;

    //! One row per string; none under a row.
    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    //! One column.
    int columnCount(const QModelIndex &parent = QModelIndex()) const override;
    //! The row's string for the display and tool-tip roles.
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    //! The translated "Data".
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;
    //! Selectable, enabled, never with children.
    Qt::ItemFlags flags(const QModelIndex &index) const override;
    using QAbstractTableModel::setData;

    //! The rows in order.
    QList<QString> data() const { return _data; }
    //! Replaces the rows in one model reset; an equal list changes nothing.
    void setData(const QList<QString> &data);
    //! Removes every row in one model reset.
    void clear();

protected:
    //! Whether \a index is a valid row of column 0.
    bool isRow(const QModelIndex &index) const;

    //! The rows; see data().
    QList<QString> _data;
};

#endif // KVT_MISCMODEL_H
