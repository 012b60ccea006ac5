// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "miscdelegatetableview.h"

#include "miscstyleditemdelegate.h"

#include <QEvent>
#include <QHeaderView>

MiscDelegateTableView::MiscDelegateTableView(QWidget *parent)
    : QTableView(parent)
{
    horizontalHeader()->setDefaultAlignment(Qt::AlignLeft);
}

MiscDelegateTableView::~MiscDelegateTableView() = default;

bool MiscDelegateTableView::edit(const QModelIndex &index, EditTrigger trigger, QEvent *event)
{
    if (qobject_cast<MiscStyledItemDelegate *>(itemDelegate(index)) && (editTriggers() & DoubleClicked)) {
        if (trigger == DoubleClicked)
            return false;
        // The release of a plain click reaches here as NoEditTriggers (or
        // SelectedClicked on a selected cell): that click opens the editor.
        if ((trigger == NoEditTriggers || trigger == SelectedClicked) && event
            && event->type() == QEvent::MouseButtonRelease) {
            QAbstractItemView::edit(index);
            return false;
        }
    }
    return QTableView::edit(index, trigger, event);
}
