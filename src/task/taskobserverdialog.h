// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TASKOBSERVERDIALOG_H
#define KVT_TASKOBSERVERDIALOG_H

#include "kvtcommon_export.h"

#include <QDialog>
#include <QItemSelection>
#include <QModelIndex>

class TaskObserver;

namespace Ui {
class TaskObserverDialog;
}

/*!
 * The window listing the tasks of a TaskObserver. "More" shows the message
 * of a failed or warning task, "Stop" asks a running, stoppable task to
 * stop. While work runs the observer blocks closing: the close button is
 * disabled and Escape and close requests are ignored.
 */
class KVTCOMMON_EXPORT TaskObserverDialog : public QDialog
{
    Q_OBJECT

public:
    //! Creates the dialog over \a observer's model (not owned) and restores its geometry.
    explicit TaskObserverDialog(TaskObserver *observer, QWidget *parent = nullptr);
    ~TaskObserverDialog() override;

    //! Disables the close button; closing and Escape are refused until unblockCloseButton().
    void blockCloseButton();
    //! Enables the close button again.
    void unblockCloseButton();
    //! Restores the geometry from "taskObserverDialog/taskObserverDialogGeometry" when stored.
    void loadSettings();
    //! Stores the geometry under "taskObserverDialog/taskObserverDialogGeometry".
    void saveSettings() const;

public Q_SLOTS:
    //! Shows the message of the selected task, titled "Error: <task>" or "Warning: <task>".
    void gotoMessageWidget();
    //! Shows the task list, titled "Tasks".
    void gotoTaskWidget();
    //! Updates the buttons for the first index of \a selection.
    void enableMoreButtonSelectChange(const QItemSelection &selection);
    /*!
     * Enables "More" for a failed or warning task and "Stop" for a running,
     * stoppable one; both are disabled for an invalid \a index.
     */
    void enableMoreButtonSelectChange(const QModelIndex &index = QModelIndex());
    //! Updates the buttons when \a index lies in the selected row.
    void enableMoreButtonDataChange(const QModelIndex &index);
    //! Shows the message page when \a checked, the task page otherwise.
    void moreButtonClick(bool checked);
    //! Shows the message of a failed or warning task.
    void doubleClick(const QModelIndex &index);
    //! Asks the selected task to stop (see TaskObserverModel::setData()).
    void stopButtonClick();

protected:
    //! Clears the selection, so both buttons start disabled.
    void showEvent(QShowEvent *event) override;
    //! Refuses to close while the close button is blocked.
    void closeEvent(QCloseEvent *event) override;
    //! Swallows Escape while the close button is blocked.
    void keyPressEvent(QKeyEvent *event) override;

private:
    QModelIndex firstSelectedIndex() const;
    bool closeBlocked() const;

    Ui::TaskObserverDialog *_ui;
    TaskObserver *_observer;
};

#endif // KVT_TASKOBSERVERDIALOG_H
