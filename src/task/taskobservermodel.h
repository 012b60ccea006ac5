// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TASKOBSERVERMODEL_H
#define KVT_TASKOBSERVERMODEL_H

#include "kvtcommon_export.h"

#include <QAbstractListModel>

class TaskObserver;

/*!
 * The task list of a TaskObserver as a table: "Task", "Status", "Message".
 *
 * Column 1 also answers the status as an integer (edit role) and the task's
 * special flags (Qt::UserRole). Setting 4 in column 1 with the edit role asks
 * a running, stoppable task to stop.
 */
class KVTCOMMON_EXPORT TaskObserverModel : public QAbstractListModel
{
    Q_OBJECT

public:
    //! Creates the model of \a observer's list (not owned), following its signals.
    explicit TaskObserverModel(TaskObserver *observer, QObject *parent = nullptr);

    //! One row per listed task; none under a row.
    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    //! Three columns: "Task", "Status" and "Message".
    int columnCount(const QModelIndex &parent = QModelIndex()) const override;
    //! The translated column names.
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;
    /*!
     * The task name (with a status icon), the status word (its number for
     * Qt::EditRole, the task's special flags for Qt::UserRole) and the message.
     */
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    /*!
     * A stop request: the value 4 (TaskDescription::AboutToBeStopped) set on
     * column 1 with Qt::EditRole asks a running, stoppable task to stop. Returns
     * false, changing nothing, when the task cannot be asked.
     */
    bool setData(const QModelIndex &index, const QVariant &value, int role = Qt::EditRole) override;

    /*!
     * The translated word of \a status: "processing", "fail", "success", "warning" or "about to be stop".
     */
    static QString statusText(int status);

public Q_SLOTS:
    //! Begins inserting rows \a first to \a last.
    void tasksAboutToBeInserted(int first, int last);
    //! Begins removing rows \a first to \a last.
    void tasksAboutToBeRemoved(int first, int last);
    //! Ends the insertion.
    void tasksInserted(int first, int last);
    //! Ends the removal.
    void tasksRemoved(int first, int last);
    //! Announces that the cells of \a row changed.
    void taskDataChanged(int row);

private:
    TaskObserver *_observer;
};

#endif // KVT_TASKOBSERVERMODEL_H
