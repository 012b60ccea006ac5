// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_MISCDELEGATETABLEVIEW_H
#define KVT_MISCDELEGATETABLEVIEW_H

#include "kvtcommon_export.h"

#include <QTableView>

/*!
 * A table view that opens the editor of a MiscStyledItemDelegate cell with a
 * single click when its edit triggers include double-click. The double click
 * itself is then refused, so that the second click of it does not reopen or
 * reset the editor. Cells with other delegates behave as in QTableView.
 *
 * Header texts are aligned to the left.
 */
class KVTCOMMON_EXPORT MiscDelegateTableView : public QTableView
{
    Q_OBJECT

public:
    //! Creates the view.
    explicit MiscDelegateTableView(QWidget *parent = nullptr);
    //! Destroys the view.
    ~MiscDelegateTableView() override;

protected:
    /*!
     * Opens the editor of a MiscStyledItemDelegate cell on a single click (see the class description).
     */
    bool edit(const QModelIndex &index, EditTrigger trigger, QEvent *event) override;
};

#endif // KVT_MISCDELEGATETABLEVIEW_H
