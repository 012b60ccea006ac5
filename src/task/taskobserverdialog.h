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
    explicit TaskObserverDialog(TaskObserver *observer, QWidget *parent = nullptr);
    ~TaskObserverDialog() override;

    void blockCloseButton();
    void unblockCloseButton();
    void loadSettings();
    void saveSettings() const;

public Q_SLOTS:
    void gotoMessageWidget();
    void gotoTaskWidget();
    void enableMoreButtonSelectChange(const QItemSelection &selection);
    void enableMoreButtonSelectChange(const QModelIndex &index = QModelIndex());
    void enableMoreButtonDataChange(const QModelIndex &index);
    void moreButtonClick(bool checked);
    void doubleClick(const QModelIndex &index);
    void stopButtonClick();

protected:
    void showEvent(QShowEvent *event) override;
    void closeEvent(QCloseEvent *event) override;
    void keyPressEvent(QKeyEvent *event) override;

private:
    QModelIndex firstSelectedIndex() const;
    bool closeBlocked() const;

    Ui::TaskObserverDialog *_ui;
    TaskObserver *_observer;
};

#endif // KVT_TASKOBSERVERDIALOG_H
