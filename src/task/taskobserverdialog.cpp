// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "taskobserverdialog.h"
#include "ui_taskobserverdialog.h"

#include "taskdescription.h"
#include "taskobserver.h"
#include "taskobservermodel.h"

#include <QCloseEvent>
#include <QHeaderView>
#include <QKeyEvent>
#include <QSettings>

namespace {

const char geometryKey[] = "taskObserverDialog/taskObserverDialogGeometry";

// Columns size themselves to their contents, which costs a look at the rows
// after every change of the list. A closed dialog skips that: the sizing is
// switched on while the dialog is shown and off while it is hidden, so a long
// run of tasks costs nothing in a window nobody sees.
class ContentSizing : public QObject
{
public:
    ContentSizing(QHeaderView *header, QObject *parent)
        : QObject(parent)
        , header(header)
    {
    }

    bool eventFilter(QObject *, QEvent *event) override
    {
        if (event->type() == QEvent::Show)
            header->setSectionResizeMode(QHeaderView::ResizeToContents);
        else if (event->type() == QEvent::Hide)
            header->setSectionResizeMode(QHeaderView::Interactive);
        return false;
    }

private:
    QHeaderView *header;
};

int statusOf(const QModelIndex &index)
{
    return index.sibling(index.row(), 1).data(Qt::EditRole).toInt();
}

} // namespace

TaskObserverDialog::TaskObserverDialog(TaskObserver *observer, QWidget *parent)
    : QDialog(parent)
    , _ui(new Ui::TaskObserverDialog)
    , _observer(observer)
{
    _ui->setupUi(this);
    setWindowFlags((windowFlags() | Qt::CustomizeWindowHint)
                   & ~(Qt::WindowMinimizeButtonHint | Qt::WindowMaximizeButtonHint
                       | Qt::WindowContextHelpButtonHint | Qt::WindowCloseButtonHint));

    _ui->_taskTreeView->setModel(observer->model());
    _ui->_taskTreeView->header()->hideSection(2);
    QHeaderView *header = _ui->_taskTreeView->header();
    installEventFilter(new ContentSizing(header, this));

    connect(_ui->_taskTreeView->selectionModel(), SIGNAL(selectionChanged(QItemSelection,QItemSelection)),
            this, SLOT(enableMoreButtonSelectChange(QItemSelection)));
    connect(observer->model(), SIGNAL(dataChanged(QModelIndex,QModelIndex)),
            this, SLOT(enableMoreButtonDataChange(QModelIndex)));

    gotoTaskWidget();
    enableMoreButtonSelectChange(QModelIndex());
    loadSettings();
}

TaskObserverDialog::~TaskObserverDialog()
{
    saveSettings();
    delete _ui;
}

void TaskObserverDialog::blockCloseButton()
{
    _ui->_buttonBox->setEnabled(false);
}

void TaskObserverDialog::unblockCloseButton()
{
    _ui->_buttonBox->setEnabled(true);
}

bool TaskObserverDialog::closeBlocked() const
{
    return !_ui->_buttonBox->isEnabled();
}

void TaskObserverDialog::loadSettings()
{
    const QVariant geometry = QSettings().value(QLatin1String(geometryKey));
    if (geometry.isValid())
        restoreGeometry(geometry.toByteArray());
}

void TaskObserverDialog::saveSettings() const
{
    QSettings().setValue(QLatin1String(geometryKey), saveGeometry());
}

QModelIndex TaskObserverDialog::firstSelectedIndex() const
{
    const QModelIndexList selected = _ui->_taskTreeView->selectionModel()->selectedIndexes();
    return selected.isEmpty() ? QModelIndex() : selected.first();
}

void TaskObserverDialog::gotoMessageWidget()
{
    const QModelIndex index = firstSelectedIndex();
    if (index.isValid()) {
        const int status = statusOf(index);
        const QString kind = status == TaskDescription::Fail ? tr("Error") : tr("Warning");
        const QString name = index.sibling(index.row(), 0).data(Qt::DisplayRole).toString();
        setWindowTitle(tr("%1: %2").arg(kind, name));
        _ui->_errorPlainTextEdit->appendPlainText(
            index.sibling(index.row(), 2).data(Qt::DisplayRole).toString());
    }
    _ui->_stackedWidget->setCurrentIndex(1);
}

void TaskObserverDialog::gotoTaskWidget()
{
    setWindowTitle(tr("Tasks"));
    _ui->_stackedWidget->setCurrentIndex(0);
    _ui->_errorPlainTextEdit->clear();
}

void TaskObserverDialog::enableMoreButtonSelectChange(const QItemSelection &selection)
{
    const QModelIndexList indexes = selection.indexes();
    enableMoreButtonSelectChange(indexes.isEmpty() ? QModelIndex() : indexes.first());
}

void TaskObserverDialog::enableMoreButtonSelectChange(const QModelIndex &index)
{
    if (!index.isValid()) {
        _ui->_morePushButton->setEnabled(false);
        _ui->_morePushButton->setChecked(false);
        _ui->_stopPushButton->setEnabled(false);
        return;
    }
    const int status = statusOf(index);
    const quint64 flags = index.sibling(index.row(), 1).data(Qt::UserRole).toULongLong();
    _ui->_morePushButton->setEnabled(status == TaskDescription::Fail || status == TaskDescription::Warning);
    _ui->_stopPushButton->setEnabled(status == TaskDescription::Processing && (flags & 1));
}

void TaskObserverDialog::enableMoreButtonDataChange(const QModelIndex &index)
{
    const QModelIndexList rows = _ui->_taskTreeView->selectionModel()->selectedRows();
    if (rows.isEmpty())
        return;
    const QModelIndex selected = rows.first();
    if (selected.row() == index.row() && selected.column() == index.column()
        && selected.internalPointer() == index.internalPointer() && selected.model() == index.model())
        enableMoreButtonSelectChange(index);
}

void TaskObserverDialog::moreButtonClick(bool checked)
{
    if (checked)
        gotoMessageWidget();
    else
        gotoTaskWidget();
}

void TaskObserverDialog::doubleClick(const QModelIndex &index)
{
    if (!index.isValid())
        return;
    const int status = statusOf(index);
    if (status == TaskDescription::Fail || status == TaskDescription::Warning)
        _ui->_morePushButton->click();
}

void TaskObserverDialog::stopButtonClick()
{
    const QModelIndex index = firstSelectedIndex();
    if (!index.isValid())
        return;
    _ui->_taskTreeView->model()->setData(index.sibling(index.row(), 1), TaskDescription::AboutToBeStopped,
                                         Qt::EditRole);
}

void TaskObserverDialog::showEvent(QShowEvent *event)
{
    QDialog::showEvent(event);
    // Both buttons start disabled: nothing is selected in a newly shown list.
    // The list page comes first too, also when the dialog was last closed with
    // Escape while it showed a message.
    _ui->_taskTreeView->clearSelection();
    enableMoreButtonSelectChange(QModelIndex());
    gotoTaskWidget();
}

void TaskObserverDialog::closeEvent(QCloseEvent *event)
{
    if (closeBlocked()) {
        event->ignore();
        return;
    }
    saveSettings();
    QDialog::closeEvent(event);
}

void TaskObserverDialog::keyPressEvent(QKeyEvent *event)
{
    if (closeBlocked() && event->key() == Qt::Key_Escape) {
        event->accept();
        return;
    }
    QDialog::keyPressEvent(event);
}
