// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementviewhelper_p.h"

#include "elementmodelextension.h"

#include <QAbstractItemView>
#include <QItemSelectionModel>

namespace ElementViewHelper {

ElementModelExtension *elements(const QAbstractItemView *view)
{
    return dynamic_cast<ElementModelExtension *>(view->model());
}

QModelIndex firstIndex(const QItemSelectionRange &range)
{
    if (!range.isValid())
        return QModelIndex();
    const QAbstractItemModel *model = range.model();
    const QModelIndex parent = range.parent();
    // The same order and the same test as QItemSelectionRange::indexes():
    // row by row, and only indexes that may be selected at all.
    for (int row = range.top(); row <= range.bottom(); ++row) {
        for (int column = range.left(); column <= range.right(); ++column) {
            const QModelIndex index = model->index(row, column, parent);
            const Qt::ItemFlags flags = model->flags(index);
            if ((flags & Qt::ItemIsSelectable) && (flags & Qt::ItemIsEnabled))
                return index;
        }
    }
    return QModelIndex();
}

QModelIndex firstIndex(const QItemSelection &selection)
{
    for (const QItemSelectionRange &range : selection) {
        const QModelIndex index = firstIndex(range);
        if (!index.isValid())
            continue;
        // The element is named by column 0 of its row.
        return index.column() == 0 ? index : index.sibling(index.row(), 0);
    }
    return QModelIndex();
}

void connectModel(QAbstractItemView *view, QAbstractItemModel *model)
{
    if (!model)
        return;
    // Unique: a second call (by a subclass, or a model set twice) must not
    // make every signal arrive twice.
    QObject::connect(model, SIGNAL(rowsInserted(QModelIndex,int,int)), view,
                     SLOT(emitCurrentElementChanged_InsertRemove(QModelIndex)), Qt::UniqueConnection);
    QObject::connect(model, SIGNAL(rowsRemoved(QModelIndex,int,int)), view,
                     SLOT(emitCurrentElementChanged_InsertRemove(QModelIndex)), Qt::UniqueConnection);
    QObject::connect(model, SIGNAL(dataChanged(QModelIndex,QModelIndex)), view,
                     SLOT(emitCurrentElementChanged_Changed(QModelIndex,QModelIndex)),
                     Qt::UniqueConnection);
    QObject::connect(model, SIGNAL(modelAboutToBeReset()), view,
                     SIGNAL(currentElementChangedStructure()), Qt::UniqueConnection);
}

void disconnectModel(QAbstractItemView *view, QAbstractItemModel *model)
{
    if (!model)
        return;
    QObject::disconnect(model, SIGNAL(rowsInserted(QModelIndex,int,int)), view,
                        SLOT(emitCurrentElementChanged_InsertRemove(QModelIndex)));
    QObject::disconnect(model, SIGNAL(rowsRemoved(QModelIndex,int,int)), view,
                        SLOT(emitCurrentElementChanged_InsertRemove(QModelIndex)));
    QObject::disconnect(model, SIGNAL(dataChanged(QModelIndex,QModelIndex)), view,
                        SLOT(emitCurrentElementChanged_Changed(QModelIndex,QModelIndex)));
    QObject::disconnect(model, SIGNAL(modelAboutToBeReset()), view,
                        SIGNAL(currentElementChangedStructure()));
}

void connectSelectionModel(QAbstractItemView *view, QItemSelectionModel *selectionModel)
{
    if (!selectionModel)
        return;
    QObject::connect(selectionModel, SIGNAL(selectionChanged(QItemSelection,QItemSelection)), view,
                     SLOT(emitCurrentElementChanged_Selection(QItemSelection)), Qt::UniqueConnection);
}

void disconnectSelectionModel(QAbstractItemView *view, QItemSelectionModel *selectionModel)
{
    if (!selectionModel)
        return;
    QObject::disconnect(selectionModel, SIGNAL(selectionChanged(QItemSelection,QItemSelection)),
                        view, SLOT(emitCurrentElementChanged_Selection(QItemSelection)));
}

bool selectionContains(const QItemSelectionModel *selectionModel, const QModelIndex &parent)
{
    if (!selectionModel || !parent.isValid())
        return false;
    const QItemSelection selection = selectionModel->selection();
    for (const QItemSelectionRange &range : selection) {
        if (range.contains(parent))
            return true;
    }
    return false;
}

QModelIndex firstChangedSelected(const QItemSelectionModel *selectionModel,
                                 const QModelIndex &topLeft, const QModelIndex &bottomRight)
{
    if (!selectionModel)
        return QModelIndex();
    const QItemSelectionRange changed(topLeft, bottomRight);
    if (!changed.isValid())
        return QModelIndex();
    const QItemSelection selection = selectionModel->selection();
    for (const QItemSelectionRange &range : selection) {
        // An intersection counts only when it holds an index that can be
        // selected at all, as QItemSelectionRange::isEmpty() sees it.
        const QModelIndex index = firstIndex(range.intersected(changed));
        if (index.isValid())
            return index;
    }
    return QModelIndex();
}

} // namespace ElementViewHelper
