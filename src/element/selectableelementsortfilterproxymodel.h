// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_SELECTABLEELEMENTSORTFILTERPROXYMODEL_H
#define KVT_SELECTABLEELEMENTSORTFILTERPROXYMODEL_H

#include "elementsortfilterproxymodel.h"

/*!
 * The elements offered for choosing: only nodes whose special flags have
 * bit 2 are shown, and their display text can be taken from another role
 * (selectionDisplayRole()), for instance the title (Qt::UserRole + 4) or the
 * element type (Qt::UserRole + 5).
 */
class KVTCOMMON_EXPORT SelectableElementSortFilterProxyModel : public ElementSortFilterProxyModel
{
    Q_OBJECT

public:
    //! Creates a proxy over every column.
    explicit SelectableElementSortFilterProxyModel(QObject *parent = nullptr);
    //! Creates a proxy over the columns in \a acceptColumns.
    SelectableElementSortFilterProxyModel(QSet<int> acceptColumns, QObject *parent = nullptr);
    //! Destroys the proxy.
    ~SelectableElementSortFilterProxyModel() override;

    //! The role shown as display text; 0 keeps the display role itself.
    int selectionDisplayRole() const;
    /*! Views are not told about the change; set the role before showing the
     *  model, or reset the views yourself. */
    void setSelectionDisplayRole(int role);

    //! The data of selectionDisplayRole() for the display role; other roles unchanged.
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;

protected:
    //! See selectionDisplayRole().
    int _selectionDisplayRole;
};

#endif // KVT_SELECTABLEELEMENTSORTFILTERPROXYMODEL_H
