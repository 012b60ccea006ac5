// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CHECKMISCMODEL_H
#define KVT_CHECKMISCMODEL_H

#include "miscmodel.h"

#include <QSet>

/*!
 * A MiscModel whose rows can be ticked.
 *
 * The model remembers the state in which the list was loaded (setData(),
 * setDataChecked(), setDataUnchecked()): dataToAdd() holds exactly the
 * strings ticked now that were not ticked then, dataToRemove() exactly those
 * unticked now that were ticked then. A caller applies just those changes.
 */
class KVTCOMMON_EXPORT CheckMiscModel : public MiscModel
{
    Q_OBJECT

public:
    //! Creates an empty model.
    explicit CheckMiscModel(QObject *parent = nullptr);
    //! Destroys the model.
    ~CheckMiscModel() override;

    //! Adds the check state (Qt::CheckStateRole) of each row.
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    //! Adds Qt::ItemIsUserCheckable to the rows.
    Qt::ItemFlags flags(const QModelIndex &index) const override;
    /*!
     * Ticks or unticks a row through Qt::CheckStateRole and records the change in
     * dataToAdd() or dataToRemove(); false when the state is unchanged.
     */
    bool setData(const QModelIndex &index, const QVariant &value, int role = Qt::EditRole) override;
    using MiscModel::data;

    //! Loads \a data with no row ticked.
    void setData(const QList<QString> &data);
    //! Loads \a list; a row is ticked when \a set holds its string.
    void setDataChecked(const QList<QString> &list, const QSet<QString> &set);
    //! Loads \a list; a row is ticked when \a set does not hold its string.
    void setDataUnchecked(const QList<QString> &list, const QSet<QString> &set);
    //! Removes every row and forgets the changes, in one model reset.
    void clear();

    //! Strings ticked now that were not ticked when the list was loaded.
    QSet<QString> dataToAdd() const { return _dataToAdd; }
    //! Strings unticked now that were ticked when the list was loaded.
    QSet<QString> dataToRemove() const { return _dataToRemove; }
    //! The strings ticked now.
    QSet<QString> checkedData() const;
    //! The strings not ticked now.
    QSet<QString> uncheckedData() const;

protected:
    //! Whether \a row is ticked; false outside the list.
    bool isChecked(int row) const;
    /*!
     * Loads \a list in one model reset, ticking a row when \a set holding its string equals \a tickedWhenInSet.
     */
    void load(const QList<QString> &list, const QSet<QString> &set, bool tickedWhenInSet);
    //! Flips the tick of \a index as asked by \a value and records the change;
    //! false when the index, the role or the state asks for nothing.
    bool changeCheckState(const QModelIndex &index, const QVariant &value, int role);

    //! One tick per row.
    QList<bool> _checked;
    //! See dataToAdd().
    QSet<QString> _dataToAdd;
    //! See dataToRemove().
    QSet<QString> _dataToRemove;
};

#endif // KVT_CHECKMISCMODEL_H
