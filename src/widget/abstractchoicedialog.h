// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ABSTRACTCHOICEDIALOG_H
#define KVT_ABSTRACTCHOICEDIALOG_H

#include "kvtcommon_export.h"

#include <QDialog>
#include <QSet>

class Element;
class FilterTreeNodeSortFilterProxyModel;

namespace Ui {
class AbstractChoiceDialog;
}

/*!
 * The common frame of the choice dialogs: a filter line with a pattern type
 * (wildcard, regular expression or fixed string), a box of display variants
 * and a tree view of the names offered. OK is enabled while a row is
 * selected; accepting the dialog calls makeChoice().
 *
 * A subclass creates its proxy model, stores it in _model and calls
 * afterConstructor() at the end of its constructor.
 *
 * The display-variant box is filled when the dialog is first shown: "All",
 * then, when the root node of the model is an element offering
 * ChangeDisplayOperation, the element's display variants, with its current
 * one selected. Choosing an entry asks the element to change its display to
 * that entry's position. Over any other root the box is disabled.
 */
class KVTCOMMON_EXPORT AbstractChoiceDialog : public QDialog
{
    Q_OBJECT

public:
    /*!
     * Builds the form with OK disabled; the subclass then sets _model and calls afterConstructor().
     */
    explicit AbstractChoiceDialog(QWidget *parent = nullptr);
    //! Destroys the dialog and its form.
    ~AbstractChoiceDialog() override;

    // Virtual interface added to QDialog's; the order of declaration is part
    // of the binary interface that plugins are built against.
    //! Applies the selection; called when the dialog is accepted.
    virtual void makeChoice() = 0;

    //! The subclass's proxy shown in the view.
    FilterTreeNodeSortFilterProxyModel *model() const { return _model; }
    //! The columns of the model that the dialog shows.
    QSet<int> acceptColumns() const { return _acceptColumns; }
    /*! The columns of the model that the dialog shows (all when empty). */
    void setAcceptColumns(const QSet<int> &columns);
    /*! Shows the subclass's proxy (in _model) in the view; called at the end
     *  of each subclass's constructor. */
    void afterConstructor();

public Q_SLOTS:
    //! Calls makeChoice(); connected to the dialog's acceptance.
    void choice();
    //! Applies the pattern and its type (wildcard, regular expression, fixed string) to the proxy.
    void changeFilter();
    /*!
     * Asks the root element to show its children in display variant \a index (ChangeDisplayOperation).
     */
    void changeDisplayVariant(int index);
    //! Enables OK exactly while a row is selected.
    void selectionChanged();

protected:
    //! Fills the display-variant box on the first showing.
    void showEvent(QShowEvent *event) override;

    //! The form; owned.
    Ui::AbstractChoiceDialog *_ui;
    //! See model(); created by the subclass's constructor.
    FilterTreeNodeSortFilterProxyModel *_model;
    //! See acceptColumns().
    QSet<int> _acceptColumns;

private:
    Element *displayElement() const;
};

#endif // KVT_ABSTRACTCHOICEDIALOG_H
