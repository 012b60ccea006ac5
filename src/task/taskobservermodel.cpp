// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "taskobservermodel.h"

#include "abstracttask.h"
#include "kvticons_p.h"
#include "taskobserver.h"

#include <QIcon>
#include <QSet>

TaskObserverModel::TaskObserverModel(TaskObserver *observer, QObject *parent)
    : QAbstractListModel(parent)
    , _observer(observer)
{
    connect(observer, SIGNAL(tasksAboutToBeInserted(int,int)), this, SLOT(tasksAboutToBeInserted(int,int)));
    connect(observer, SIGNAL(tasksAboutToBeRemoved(int,int)), this, SLOT(tasksAboutToBeRemoved(int,int)));
    connect(observer, SIGNAL(tasksInserted(int,int)), this, SLOT(tasksInserted(int,int)));
    connect(observer, SIGNAL(tasksRemoved(int,int)), this, SLOT(tasksRemoved(int,int)));
    connect(observer, SIGNAL(taskDataChanged(int)), this, SLOT(taskDataChanged(int)));
}

int TaskObserverModel::rowCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : _observer->rows().size();
}

int TaskObserverModel::columnCount(const QModelIndex &parent) const
{
    return parent.isValid() ? 0 : 3;
}

QVariant TaskObserverModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (orientation == Qt::Vertical || (role != Qt::DisplayRole && role != Qt::ToolTipRole))
        return QVariant();
    switch (section) {
    case 0:
        return tr("Task");
    case 1:
        return tr("Status");
    case 2:
        return tr("Message");
    default:
        return QVariant();
    }
}

QString TaskObserverModel::statusText(int status)
{
    switch (status) {
    case TaskDescription::Processing:
        return tr("processing");
    case TaskDescription::Fail:
        return tr("fail");
    case TaskDescription::Success:
        return tr("success");
    case TaskDescription::Warning:
        return tr("warning");
    case TaskDescription::AboutToBeStopped:
        return tr("about to be stop");
    default:
        return QString();
    }
}

namespace {

// Models between the two removal signals of a clearing that removes rows.
QSet<const TaskObserverModel *> &removingModels()
{
    static QSet<const TaskObserverModel *> models;
    return models;
}

QIcon statusIcon(int status)
{
    switch (status) {
    case TaskDescription::Processing:
        return kvtThemeIcon(QStringLiteral("task-ongoing"));
    case TaskDescription::Fail:
        return kvtThemeIcon(QStringLiteral("task-reject"));
    case TaskDescription::Success:
        return kvtThemeIcon(QStringLiteral("task-complete"));
    case TaskDescription::Warning:
    case TaskDescription::AboutToBeStopped:
        return kvtThemeIcon(QStringLiteral("task-attention"));
    default:
        return QIcon();
    }
}

} // namespace

QVariant TaskObserverModel::data(const QModelIndex &index, int role) const
{
    if (!checkIndex(index, CheckIndexOption::IndexIsValid | CheckIndexOption::ParentIsInvalid))
        return QVariant();
    const TaskObserver::Row &row = _observer->rows().at(index.row());
    const bool text = role == Qt::DisplayRole || role == Qt::ToolTipRole;
    switch (index.column()) {
    case 0:
        if (text)
            return row.description.description();
        if (role == Qt::DecorationRole)
            return statusIcon(row.description.status());
        break;
    case 1:
        if (text)
            return statusText(row.description.status());
        if (role == Qt::EditRole)
            return int(row.description.status());
        if (role == Qt::UserRole)
            return QVariant::fromValue<quint64>(_observer->rowTaskSpecialFlags(index.row()));
        break;
    case 2:
        if (text)
            return row.description.message();
        break;
    }
    return QVariant();
}

bool TaskObserverModel::setData(const QModelIndex &index, const QVariant &value, int role)
{
    // The only edit is a stop request: 4 ("about to be stopped") in column 1.
    if (role != Qt::EditRole || index.column() != 1 || value.toInt() != TaskDescription::AboutToBeStopped
        || !checkIndex(index, CheckIndexOption::IndexIsValid | CheckIndexOption::ParentIsInvalid))
        return false;
    if (!_observer->requestStop(index.row()))
        return false;
    Q_EMIT dataChanged(this->index(index.row(), 0), this->index(index.row(), 2), QVector<int>());
    return true;
}

void TaskObserverModel::tasksAboutToBeInserted(int first, int last)
{
    beginInsertRows(QModelIndex(), first, last);
}

void TaskObserverModel::tasksInserted(int, int)
{
    endInsertRows();
}

// The observer clears its whole list at once and announces it with the row
// count in both arguments. Views and proxies need the rows that go, so the
// clearing is passed on as the removal of rows 0 to count - 1.
void TaskObserverModel::tasksAboutToBeRemoved(int first, int last)
{
    const int rows = rowCount();
    if (first == rows && last == rows) {
        first = 0;
        last = rows - 1;
    }
    if (last < first)
        return;
    removingModels().insert(this);
    beginRemoveRows(QModelIndex(), first, last);
}

void TaskObserverModel::tasksRemoved(int, int)
{
    if (removingModels().remove(this))
        endRemoveRows();
}

void TaskObserverModel::taskDataChanged(int row)
{
    if (row < 0 || row >= rowCount())
        return;
    Q_EMIT dataChanged(index(row, 0), index(row, 2), QVector<int>());
}
