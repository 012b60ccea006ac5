// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "blockdialog.h"

#include <QEvent>
#include <QGuiApplication>

namespace {

// Shows the busy cursor over the application while the dialog it watches is
// visible, and puts the cursor back however the dialog goes away.
class BusyCursorWhileShown : public QObject
{
public:
    explicit BusyCursorWhileShown(QWidget *dialog)
        : QObject(dialog)
    {
        dialog->installEventFilter(this);
    }

    ~BusyCursorWhileShown() override { setBusy(false); }

    bool eventFilter(QObject *watched, QEvent *event) override
    {
        if (event->type() == QEvent::Show)
            setBusy(true);
        else if (event->type() == QEvent::Hide)
            setBusy(false);
        return QObject::eventFilter(watched, event);
    }

private:
    void setBusy(bool busy)
    {
        if (busy == _busy)
            return;
        _busy = busy;
        if (busy)
            QGuiApplication::setOverrideCursor(Qt::BusyCursor);
        else
            QGuiApplication::restoreOverrideCursor();
    }

    bool _busy = false;
};

} // namespace

BlockDialog::BlockDialog(QWidget *parent)
    // It only keeps input away from the other windows during a task's first
    // second, so nothing of it is seen: no frame, no content, one transparent
    // pixel. The busy cursor tells the user that work is going on.
    : QDialog(parent, Qt::Dialog | Qt::FramelessWindowHint)
{
    setModal(true);
    setAttribute(Qt::WA_DeleteOnClose);
    setAttribute(Qt::WA_TranslucentBackground);
    setFixedSize(1, 1);
    new BusyCursorWhileShown(this);
}
