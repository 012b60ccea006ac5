// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CHOICEFILTERTREENODESORTFILTERPROXYMODEL_H
#define KVT_CHOICEFILTERTREENODESORTFILTERPROXYMODEL_H

#include "filtertreenodesortfilterproxymodel.h"

/*!
 * Shows either the ticked or the unticked rows of a ChoiceTreeNodeProxyModel
 * (its source), among those that pass the special-flags filter and the text
 * filter of FilterTreeNodeSortFilterProxyModel. Nodes whose special flags
 * have bit 1 are hidden.
 */
class KVTCOMMON_EXPORT ChoiceFilterTreeNodeSortFilterProxyModel : public FilterTreeNodeSortFilterProxyModel
{
    Q_OBJECT

public:
    //! Creates a proxy of the ticked rows when \a checked is true, of the unticked ones otherwise.
    explicit ChoiceFilterTreeNodeSortFilterProxyModel(bool checked, QObject *parent = nullptr);
    //! Destroys the proxy.
    ~ChoiceFilterTreeNodeSortFilterProxyModel() override;

    //! Whether the proxy shows the ticked rows (true) or the unticked ones.
    bool checked() const { return _checked; }

protected:
    /*!
     * Accepts a row that passes the flags and text filters and whose ticked state equals checked().
     */
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;

    //! See checked().
    bool _checked;
};

#endif // KVT_CHOICEFILTERTREENODESORTFILTERPROXYMODEL_H
