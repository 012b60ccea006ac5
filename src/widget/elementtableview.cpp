// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementtableview.h"

#include "elementviewhelper_p.h"

#include <QHeaderView>

ElementTableView::ElementTableView(QWidget *parent)
    : QTableView(parent)
{
    setContextMenuPolicy(Qt::CustomContextMenu);
    horizontalHeader()->setDefaultAlignment(Qt::AlignLeft);
}

ElementTableView::~ElementTableView() = default;

void ElementTableView::setModel(QAbstractItemModel *model)
{
    ElementViewHelper::setModel<QTableView>(this, model);
}

void ElementTableView::setSelectionModel(QItemSelectionModel *selectionModel)
{
    ElementViewHelper::setSelectionModel<QTableView>(this, selectionModel);
}

void ElementTableView::connectModel()
{
    ElementViewHelper::connectModel(this, model());
    ElementViewHelper::connectSelectionModel(this, selectionModel());
}

void ElementTableView::disconnectModel()
{
    ElementViewHelper::disconnectModel(this, model());
    ElementViewHelper::disconnectSelectionModel(this, selectionModel());
}

void ElementTableView::emitCurrentElementChanged_Selection(const QItemSelection &selected)
{
    ElementViewHelper::emitSelectionChange(this, selected);
}

void ElementTableView::emitCurrentElementChanged_InsertRemove(const QModelIndex &parent)
{
    ElementViewHelper::emitInsertRemove(this, parent);
}

void ElementTableView::emitCurrentElementChanged_Changed(const QModelIndex &topLeft, const QModelIndex &bottomRight)
{
    ElementViewHelper::emitDataChange(this, topLeft, bottomRight);
}

void ElementTableView::focusInEvent(QFocusEvent *event)
{
    ElementViewHelper::emitFocusIn(this);
    QTableView::focusInEvent(event);
}
