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
    explicit CheckMiscModel(QObject *parent = nullptr);
    ~CheckMiscModel() override;

    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    Qt::ItemFlags flags(const QModelIndex &index) const override;
    bool setData(const QModelIndex &index, const QVariant &value, int role = Qt::EditRole) override;
    using MiscModel::data;

    //! Loads \a data with no row ticked.
    void setData(const QList<QString> &data);
    //! Loads \a list; a row is ticked when \a set holds its string.
    void setDataChecked(const QList<QString> &list, const QSet<QString> &set);
    //! Loads \a list; a row is ticked when \a set does not hold its string.
    void setDataUnchecked(const QList<QString> &list, const QSet<QString> &set);
    void clear();

    QSet<QString> dataToAdd() const { return _dataToAdd; }
    QSet<QString> dataToRemove() const { return _dataToRemove; }
    QSet<QString> checkedData() const;
    QSet<QString> uncheckedData() const;

protected:
    bool isChecked(int row) const;
    void load(const QList<QString> &list, const QSet<QString> &set, bool tickedWhenInSet);
    // Flips the tick of \a index as asked by \a value and records the change;
    // false when the index, the role or the state asks for nothing.
    bool changeCheckState(const QModelIndex &index, const QVariant &value, int role);

    QList<bool> _checked;
    QSet<QString> _dataToAdd;
    QSet<QString> _dataToRemove;
};

#endif // KVT_CHECKMISCMODEL_H
