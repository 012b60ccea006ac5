// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CONFIGURECHECKMODEL_H
#define KVT_CONFIGURECHECKMODEL_H

#include "checkmiscmodel.h"

#include <QStringList>

/*!
 * A CheckMiscModel of modes with a description each (Qt::UserRole) and pairs
 * of modes that exclude each other.
 *
 * While a row is ticked, every row incompatible with it is disabled and shows
 * no check box. A pair of rows a < b is stored in inCmpatibleModes() as the
 * key a * n + b, where n is the number of rows of the loaded list; callers
 * fill the set the same way.
 */
class KVTCOMMON_EXPORT ConfigureCheckModel : public CheckMiscModel
{
    Q_OBJECT

public:
    //! Creates an empty model.
    explicit ConfigureCheckModel(QObject *parent = nullptr);
    //! Destroys the model.
    ~ConfigureCheckModel() override;

    //! Adds the description (Qt::UserRole); an excluded row has no check state.
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    //! An excluded row is neither enabled nor checkable.
    Qt::ItemFlags flags(const QModelIndex &index) const override;
    /*!
     * Ticks or unticks like CheckMiscModel and announces the whole column changed, since other rows may be excluded or freed.
     */
    bool setData(const QModelIndex &index, const QVariant &value, int role = Qt::EditRole) override;
    using CheckMiscModel::data;
    using CheckMiscModel::setData;

    // The name is spelled so on purpose: callers know it by this name.
    //! The incompatible pairs, encoded as described above.
    QSet<int> inCmpatibleModes() const { return _inCmpatibleModes; }
    //! Replaces the incompatible pairs in one model reset; an equal set changes nothing.
    void setInCmpatibleModes(const QSet<int> &modes);
    //! One description per row.
    QStringList descriptions() const { return _descriptions; }
    //! Replaces the descriptions.
    void setDescriptions(const QStringList &descriptions);

    //! Whether rows \a a and \a b may be ticked together; false for a row
    //! outside the list.
    bool checkCompatible(int a, int b) const;

protected:
    //! Whether some ticked row excludes \a row.
    bool isExcluded(int row) const;

    //! See inCmpatibleModes().
    QSet<int> _inCmpatibleModes;
    //! See descriptions().
    QStringList _descriptions;
};

#endif // KVT_CONFIGURECHECKMODEL_H
