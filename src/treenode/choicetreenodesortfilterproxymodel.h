// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CHOICETREENODESORTFILTERPROXYMODEL_H
#define KVT_CHOICETREENODESORTFILTERPROXYMODEL_H

#include "treenodesortfilterproxymodel.h"

/*!
 * Shows either the ticked or the unticked rows of a ChoiceTreeNodeProxyModel
 * (its source): the ticked ones when checked() is true.
 *
 * Over any other source every row is shown. The row test looks at the ticked
 * state only; the special flags of the nodes are not consulted.
 */
class KVTCOMMON_EXPORT ChoiceTreeNodeSortFilterProxyModel : public TreeNodeSortFilterProxyModel
{
    Q_OBJECT

public:
    //! Creates a proxy of the ticked rows when \a checked is true, of the unticked ones otherwise.
    explicit ChoiceTreeNodeSortFilterProxyModel(bool checked, QObject *parent = nullptr);
    //! Destroys the proxy.
    ~ChoiceTreeNodeSortFilterProxyModel() override;

    //! Whether the proxy shows the ticked rows (true) or the unticked ones.
    bool checked() const { return _checked; }

protected:
    //! Accepts a row whose ticked state equals checked().
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;

    //! See checked().
    bool _checked;
};

#endif // KVT_CHOICETREENODESORTFILTERPROXYMODEL_H
