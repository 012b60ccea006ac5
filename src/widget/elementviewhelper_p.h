// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTVIEWHELPER_P_H
#define KVT_ELEMENTVIEWHELPER_P_H

#include "element.h"
#include "elementmodelextension.h"

#include <QItemSelection>
#include <QItemSelectionModel>
#include <QModelIndex>

class QAbstractItemModel;
class QAbstractItemView;
class QItemSelectionModel;
class ElementModelExtension;

/*
 * What ElementTableView and ElementTreeView share. The two views are twins
 * that differ only in their base class; their signals and slots have the same
 * names, so the connections here are made by name on either of them.
 */
namespace ElementViewHelper {

// The view's model as an element model, or null.
ElementModelExtension *elements(const QAbstractItemView *view);

// The first selectable and enabled index of a selection (what
// QItemSelection::indexes() would list first, without listing them all),
// moved to column 0 of its row; invalid for an empty selection.
QModelIndex firstIndex(const QItemSelection &selection);

// The first selectable and enabled index of a range, in any column.
QModelIndex firstIndex(const QItemSelectionRange &range);

void connectModel(QAbstractItemView *view, QAbstractItemModel *model);
void disconnectModel(QAbstractItemView *view, QAbstractItemModel *model);
void connectSelectionModel(QAbstractItemView *view, QItemSelectionModel *selectionModel);
void disconnectSelectionModel(QAbstractItemView *view, QItemSelectionModel *selectionModel);

// The selected range holding parent, when parent is valid: rows inserted or
// removed below it change the structure under the selection.
bool selectionContains(const QItemSelectionModel *selectionModel, const QModelIndex &parent);

// The first index of the first non-empty intersection of the changed
// rectangle with the selection; invalid when the change misses it.
QModelIndex firstChangedSelected(const QItemSelectionModel *selectionModel,
                                 const QModelIndex &topLeft, const QModelIndex &bottomRight);

// The behaviour of both views, written once; View is ElementTableView or
// ElementTreeView and Base its toolkit view class.

template<class Base, class View>
void setModel(View *view, QAbstractItemModel *model)
{
    // The old selection model outlives the switch (the base view does not
    // delete it), so its connection must be cut before it is replaced.
    view->disconnectModel();
    view->Base::setModel(model);
    view->connectModel();
}

template<class Base, class View>
void setSelectionModel(View *view, QItemSelectionModel *selectionModel)
{
    disconnectSelectionModel(view, view->selectionModel());
    view->Base::setSelectionModel(selectionModel);
    connectSelectionModel(view, view->selectionModel());
}

template<class View>
void emitSelectionChange(View *view, const QItemSelection &selected)
{
    const QModelIndex index = firstIndex(selected);
    Q_EMIT view->currentElementChangedStructure(index);
    // Without the focus the selection was made by the program (a search, a
    // restored state): the operations offered to the user stay those of the
    // widget that has the focus.
    if (!view->hasFocus())
        return;
    if (const ElementModelExtension *extension = elements(view))
        Q_EMIT view->elementContextOperationChangedSelected(extension->toElement(index));
}

template<class View>
void emitInsertRemove(View *view, const QModelIndex &parent)
{
    if (selectionContains(view->selectionModel(), parent))
        Q_EMIT view->currentElementChangedStructure(parent);
}

template<class View>
void emitDataChange(View *view, const QModelIndex &topLeft, const QModelIndex &bottomRight)
{
    const QModelIndex index = firstChangedSelected(view->selectionModel(), topLeft, bottomRight);
    if (!index.isValid())
        return;
    if (const ElementModelExtension *extension = elements(view))
        Q_EMIT view->elementContextOperationChangedChanged(extension->toElement(index));
}

template<class View>
void emitFocusIn(View *view)
{
    if (const ElementModelExtension *extension = elements(view)) {
        const QModelIndex index = view->selectionModel() ? firstIndex(view->selectionModel()->selection())
                                                         : QModelIndex();
        Q_EMIT view->elementContextOperationChangedFocused(extension->toElement(index));
    }
}

} // namespace ElementViewHelper

#endif // KVT_ELEMENTVIEWHELPER_P_H
