// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "dialoganswerer.h"

#include <QAbstractButton>
#include <QApplication>
#include <QFileDialog>
#include <QLineEdit>

DialogAnswerer::DialogAnswerer(QObject *parent)
    : QObject(parent)
{
    connect(&_timer, SIGNAL(timeout()), this, SLOT(poll()));
    _timer.start(10);
}

void DialogAnswerer::poll()
{
    auto *dialog = qobject_cast<QDialog *>(QApplication::activeModalWidget());
    if (!dialog || !dialog->isVisible())
        return;
    // The task observer's own windows come and go by themselves.
    if (dialog->inherits("BlockDialog") || dialog->inherits("TaskObserverDialog"))
        return;

    if (auto *box = qobject_cast<QMessageBox *>(dialog)) {
        seen.append(QStringLiteral("%1|%2|%3").arg(box->windowTitle(), box->text())
                        .arg(int(box->standardButtons())));
        const QMessageBox::StandardButton button =
            _answers.isEmpty() ? QMessageBox::NoButton : _answers.takeFirst();
        if (QAbstractButton *b = box->button(button))
            b->click();
        else
            box->reject();
        return;
    }

    if (auto *files = qobject_cast<QFileDialog *>(dialog)) {
        seen.append(QStringLiteral("file:%1").arg(files->windowTitle()));
        const QString name = _files.isEmpty() ? QString() : _files.takeFirst();
        if (name.isEmpty()) {
            files->reject();
        } else {
            files->selectFile(name);
            // The dialog may still fill in its suggested name while it
            // settles; what is typed is what it takes.
            if (auto *edit = files->findChild<QLineEdit *>(QStringLiteral("fileNameEdit")))
                edit->setText(name);
            QMetaObject::invokeMethod(files, "accept");
        }
        return;
    }

    seen.append(QStringLiteral("dialog:%1").arg(QLatin1String(dialog->metaObject()->className())));
    if (inspect)
        inspect(dialog);
    const QMessageBox::StandardButton button =
        _answers.isEmpty() ? QMessageBox::NoButton : _answers.takeFirst();
    if (button == QMessageBox::Ok || button == QMessageBox::Yes || button == QMessageBox::Save)
        dialog->accept();
    else
        dialog->reject();
}
