// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "multichecktreeview.h"

#include <QKeyEvent>

MultiCheckTreeView::MultiCheckTreeView(QWidget *parent)
    : QTreeView(parent)
{
}

MultiCheckTreeView::~MultiCheckTreeView() = default;

void MultiCheckTreeView::keyPressEvent(QKeyEvent *event)
{
    if (event->key() != Qt::Key_Space || !model() || !selectionModel()) {
        QTreeView::keyPressEvent(event);
        return;
    }
    QList<QPersistentModelIndex> checkable;
    const QModelIndexList selected = selectionModel()->selectedIndexes();
    for (const QModelIndex &index : selected) {
        if (model()->flags(index) & Qt::ItemIsUserCheckable)
            checkable.append(index);
    }
    if (checkable.size() < 2) {
        QTreeView::keyPressEvent(event);
        return;
    }
    // Persistent indexes: a toggle may make the model move rows.
    for (const QPersistentModelIndex &index : qAsConst(checkable)) {
        if (index.isValid())
            edit(index, QAbstractItemView::EditKeyPressed, event);
    }
}
