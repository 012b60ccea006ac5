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
    explicit TaskObserverModel(TaskObserver *observer, QObject *parent = nullptr);

    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    int columnCount(const QModelIndex &parent = QModelIndex()) const override;
    QVariant headerData(int section, Qt::Orientation orientation, int role = Qt::DisplayRole) const override;
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    bool setData(const QModelIndex &index, const QVariant &value, int role = Qt::EditRole) override;

    static QString statusText(int status);

public Q_SLOTS:
    void tasksAboutToBeInserted(int first, int last);
    void tasksAboutToBeRemoved(int first, int last);
    void tasksInserted(int first, int last);
    void tasksRemoved(int first, int last);
    void taskDataChanged(int row);

private:
    TaskObserver *_observer;
};

#endif // KVT_TASKOBSERVERMODEL_H
