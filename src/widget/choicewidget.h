// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CHOICEWIDGET_H
#define KVT_CHOICEWIDGET_H

#include "kvtcommon_export.h"

#include <QGroupBox>
#include <QItemSelection>
#include <QModelIndex>
#include <QSet>

class ChoiceDialog;
class ChoiceTreeNodeProxyModel;
class ChoiceTreeNodeSortFilterProxyModel;
class TreeNode;

namespace Ui {
class ChoiceWidget;
}

/*!
 * Shows the ticked names of a ChoiceTreeNodeProxyModel, with Add and Remove
 * buttons: Add opens a ChoiceDialog offering the names not ticked, Remove
 * unticks the selected names. Remove is enabled while a name is selected.
 *
 * With choosing disabled, nothing can be selected and Add is disabled: the
 * list only shows the choice.
 */
class KVTCOMMON_EXPORT ChoiceWidget : public QGroupBox
{
    Q_OBJECT

public:
    //! Creates the widget and its ChoiceDialog; give it a model with setChoiceModel().
    explicit ChoiceWidget(QWidget *parent = nullptr);
    //! Destroys the widget and its dialog; the choice model is not owned.
    ~ChoiceWidget() override;

    //! The model of the ticked names, or null.
    ChoiceTreeNodeProxyModel *choiceModel() const { return _choiceModel; }
    /*! Hands \a model (not owned) to the dialog and shows its ticked rows. */
    void setChoiceModel(ChoiceTreeNodeProxyModel *model);

    //! The columns of the choice model that the widget's list shows.
    QSet<int> acceptColumns() const;
    /*! The columns of the choice model that the widget's list shows (all when
     *  empty). The dialog has its own, set through choiceDialog(). */
    void setAcceptColumns(const QSet<int> &columns);

    //! Whether the user may change the choice.
    bool isChoiceEnabled() const { return _choiceEnabled; }
    //! Allows or forbids changing the choice (see the class description).
    void setChoiceEnabled(bool enabled);

    //! The dialog that Add opens; owned by the widget.
    ChoiceDialog *choiceDialog() const { return _choiceDialog; }

Q_SIGNALS:
    //! A ticked name was double-clicked; \a node is its tree node.
    void treeNodeDoubleClicked(TreeNode *node);

public Q_SLOTS:
    //! Unticks every selected name; connected to Remove.
    void unchoice();
    //! Emits treeNodeDoubleClicked() for the node of \a index.
    void doubleClicked(const QModelIndex &index);
    //! Enables Remove exactly while a name is selected.
    void selectionChanged(const QItemSelection &selection = QItemSelection());

protected:
    //! The form; owned.
    Ui::ChoiceWidget *_ui;
    //! See choiceDialog().
    ChoiceDialog *_choiceDialog;
    //! The proxy of the ticked rows shown in the list; owned.
    ChoiceTreeNodeSortFilterProxyModel *_model;
    //! See choiceModel(); not owned.
    ChoiceTreeNodeProxyModel *_choiceModel;
    //! See isChoiceEnabled().
    bool _choiceEnabled;
};

#endif // KVT_CHOICEWIDGET_H
