// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementtreeview.h"

#include "elementviewhelper_p.h"

ElementTreeView::ElementTreeView(QWidget *parent)
    : QTreeView(parent)
{
    setContextMenuPolicy(Qt::CustomContextMenu);
}

ElementTreeView::~ElementTreeView() = default;

void ElementTreeView::setModel(QAbstractItemModel *model)
{
    ElementViewHelper::setModel<QTreeView>(this, model);
}

void ElementTreeView::setSelectionModel(QItemSelectionModel *selectionModel)
{
    ElementViewHelper::setSelectionModel<QTreeView>(this, selectionModel);
}

void ElementTreeView::connectModel()
{
    ElementViewHelper::connectModel(this, model());
    ElementViewHelper::connectSelectionModel(this, selectionModel());
}

void ElementTreeView::disconnectModel()
{
    ElementViewHelper::disconnectModel(this, model());
    ElementViewHelper::disconnectSelectionModel(this, selectionModel());
}

void ElementTreeView::emitCurrentElementChanged_Selection(const QItemSelection &selected)
{
    ElementViewHelper::emitSelectionChange(this, selected);
}

void ElementTreeView::emitCurrentElementChanged_InsertRemove(const QModelIndex &parent)
{
    ElementViewHelper::emitInsertRemove(this, parent);
}

void ElementTreeView::emitCurrentElementChanged_Changed(const QModelIndex &topLeft, const QModelIndex &bottomRight)
{
    ElementViewHelper::emitDataChange(this, topLeft, bottomRight);
}

void ElementTreeView::focusInEvent(QFocusEvent *event)
{
    ElementViewHelper::emitFocusIn(this);
    QTreeView::focusInEvent(event);
}
