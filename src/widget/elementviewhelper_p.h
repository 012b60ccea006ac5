#ifndef KVT_ELEMENTVIEWHELPER_P_H
#define KVT_ELEMENTVIEWHELPER_P_H

#include <QItemSelection>
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

} // namespace ElementViewHelper

#endif // KVT_ELEMENTVIEWHELPER_P_H
