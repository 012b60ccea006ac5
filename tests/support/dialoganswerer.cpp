#include "dialoganswerer.h"

#include <QAbstractButton>
#include <QApplication>
#include <QTest>

DialogAnswerer::DialogAnswerer(QObject *parent)
    : QObject(parent)
{
    connect(&_timer, SIGNAL(timeout()), this, SLOT(poll()));
    _timer.start(10);
}

void DialogAnswerer::poll()
{
    auto *box = qobject_cast<QMessageBox *>(QApplication::activeModalWidget());
    if (!box || !box->isVisible())
        return;
    seen.append(QStringLiteral("%1|%2|%3").arg(box->windowTitle(), box->text())
                    .arg(int(box->standardButtons())));
    const QMessageBox::StandardButton button =
        _answers.isEmpty() ? QMessageBox::NoButton : _answers.takeFirst();
    if (QAbstractButton *b = box->button(button))
        b->click();
    else
        box->reject();
}
