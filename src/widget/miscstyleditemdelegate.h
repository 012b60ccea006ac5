// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_MISCSTYLEDITEMDELEGATE_H
#define KVT_MISCSTYLEDITEMDELEGATE_H

#include "kvtcommon_export.h"

#include <QStyledItemDelegate>

/*!
 * Base of the editor delegates that write every change to the model while
 * the user is still editing: each editor's change signal is connected to
 * afterEditorChange(), which commits the editor at once. The editor covers
 * exactly the cell.
 *
 * MiscDelegateTableView opens editors of this family with a single click.
 */
class KVTCOMMON_EXPORT MiscStyledItemDelegate : public QStyledItemDelegate
{
    Q_OBJECT

public:
    //! Creates the delegate.
    explicit MiscStyledItemDelegate(QObject *parent = nullptr);
    //! Destroys the delegate.
    ~MiscStyledItemDelegate() override;

    //! Gives the editor exactly the cell's rectangle.
    void updateEditorGeometry(QWidget *editor, const QStyleOptionViewItem &option,
                              const QModelIndex &index) const override;

public Q_SLOTS:
    /*! Commits the editor that sent the change signal. */
    void afterEditorChange();
};

#endif // KVT_MISCSTYLEDITEMDELEGATE_H
