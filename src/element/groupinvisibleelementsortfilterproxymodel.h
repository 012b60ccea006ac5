// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_GROUPINVISIBLEELEMENTSORTFILTERPROXYMODEL_H
#define KVT_GROUPINVISIBLEELEMENTSORTFILTERPROXYMODEL_H

#include "elementsortfilterproxymodel.h"

/*!
 * Shows the elements of one group: those whose Element::groupElementType()
 * (their own or, while undefined, the nearest ancestor's) equals
 * groupElementType(). Nodes marked hidden (special flag bit 1), such as
 * supplement elements, are not shown either.
 *
 * The group "Undefined", the initial one, shows every element. No other
 * name is special: a filter on "All" shows only elements of a group called
 * "All". Rows that are no elements are always shown (if their flags allow).
 */
class KVTCOMMON_EXPORT GroupInvisibleElementSortFilterProxyModel : public ElementSortFilterProxyModel
{
    Q_OBJECT

public:
    //! Creates a proxy over every column that shows every group.
    explicit GroupInvisibleElementSortFilterProxyModel(QObject *parent = nullptr);
    //! Creates a proxy over the columns in \a acceptColumns that shows every group.
    GroupInvisibleElementSortFilterProxyModel(QSet<int> acceptColumns, QObject *parent = nullptr);
    //! Destroys the proxy.
    ~GroupInvisibleElementSortFilterProxyModel() override;

    //! The group shown; "Undefined" shows all.
    QString groupElementType() const;
    /*! Takes \a type and filters again; unless \a force is true, the type
     *  already set is left alone without filtering. Forcing is for a tree
     *  whose groups changed while the filter stayed the same. */
    void setGroupElementType(const QString &type, bool force = false);

protected:
    //! Accepts the rows of the group (see the class description).
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;

    //! See groupElementType().
    QString _groupElementType;
};

#endif // KVT_GROUPINVISIBLEELEMENTSORTFILTERPROXYMODEL_H
