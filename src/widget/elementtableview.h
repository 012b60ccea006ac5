// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTTABLEVIEW_H
#define KVT_ELEMENTTABLEVIEW_H

#include "kvtcommon_export.h"

#include <QTableView>

class Element;

/*!
 * A QTableView that lists elements and reports, element by element, what
 * happens in its model and its selection:
 * - currentElementChangedStructure(index): the selection's current entry
 *   changed (index is column 0 of the first selected row, invalid when the
 *   selection became empty), rows were inserted below or removed from
 *   under a selected row (index is that row), or the model is about to be
 *   reset (invalid index);
 * - elementContextOperationChangedFocused(element): the view got the
 *   keyboard focus; the element is that of the first selected row, or null;
 * - elementContextOperationChangedSelected(element): the selection changed
 *   while the view has the keyboard focus (a selection made by the program
 *   while another widget has the focus is not reported here);
 * - elementContextOperationChangedChanged(element): the data of a selected
 *   row changed.
 *
 * Elements are found through the model when it is an ElementModelExtension
 * (an element model or element proxy); over any other model only
 * currentElementChangedStructure() is emitted.
 *
 * The context menu policy is Qt::CustomContextMenu, so the owner builds the
 * menu from the current element's operations.
 */
class KVTCOMMON_EXPORT ElementTableView : public QTableView
{
    Q_OBJECT

public:
    //! Creates the view with the custom context menu policy.
    explicit ElementTableView(QWidget *parent = nullptr);
    //! Destroys the view.
    ~ElementTableView() override;

    /*! Moves the connections listed under connectModel() from the old model
     *  and selection model to the new ones. */
    void setModel(QAbstractItemModel *model) override;
    /*! Keeps the selection signal when the selection model is replaced on
     *  its own, for instance to share one selection between two views. */
    void setSelectionModel(QItemSelectionModel *selectionModel) override;

    /*! Connects the model's rowsInserted(), rowsRemoved(), dataChanged() and
     *  modelAboutToBeReset() and the selection model's selectionChanged() to
     *  this view. Calling it again adds no second connection. */
    void connectModel();
    //! Removes the connections made by connectModel().
    void disconnectModel();

Q_SIGNALS:
    //! The current entry, or the structure below it, changed (see the class description).
    void currentElementChangedStructure(const QModelIndex &index = QModelIndex());
    //! The view got the focus; \a element is the selected one, or null.
    void elementContextOperationChangedFocused(Element *element);
    /*!
     * The selection changed while the view has the focus; \a element is the newly selected one, or null.
     */
    void elementContextOperationChangedSelected(Element *element);
    //! The data of the selected \a element changed.
    void elementContextOperationChangedChanged(Element *element);

public Q_SLOTS:
    //! Reports a selection change; connected to the selection model.
    void emitCurrentElementChanged_Selection(const QItemSelection &selected);
    //! Reports rows inserted or removed under a selected row; connected to the model.
    void emitCurrentElementChanged_InsertRemove(const QModelIndex &parent);
    //! Reports a data change of a selected row; connected to the model.
    void emitCurrentElementChanged_Changed(const QModelIndex &topLeft, const QModelIndex &bottomRight);

protected:
    //! Emits elementContextOperationChangedFocused().
    void focusInEvent(QFocusEvent *event) override;
};

#endif // KVT_ELEMENTTABLEVIEW_H
