// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_MULTICHECKTREEVIEW_H
#define KVT_MULTICHECKTREEVIEW_H

#include "kvtcommon_export.h"

#include <QTreeView>

/*!
 * A tree view in which the space bar toggles the check boxes of all selected
 * checkable items at once, each through its delegate as for a single item.
 * With fewer than two such items selected, space behaves as in QTreeView.
 */
class KVTCOMMON_EXPORT MultiCheckTreeView : public QTreeView
{
    Q_OBJECT

public:
    //! Creates the view.
    explicit MultiCheckTreeView(QWidget *parent = nullptr);
    //! Destroys the view.
    ~MultiCheckTreeView() override;

protected:
    //! Toggles all selected check boxes on the space bar.
    void keyPressEvent(QKeyEvent *event) override;
};

#endif // KVT_MULTICHECKTREEVIEW_H
