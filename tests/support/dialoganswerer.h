#ifndef KVT_TEST_DIALOGANSWERER_H
#define KVT_TEST_DIALOGANSWERER_H

#include <QMessageBox>
#include <QObject>
#include <QStringList>
#include <QTimer>

/*!
 * Answers the message boxes a test provokes, so that no test waits on a
 * dialog. While it lives it polls QApplication::activeModalWidget(); each
 * message box it finds is recorded as "<title>|<text>|<buttons>" (buttons as
 * the sum of their QMessageBox::StandardButton values) and answered with the
 * next queued button, or closed with Escape when none is queued.
 */
class DialogAnswerer : public QObject
{
    Q_OBJECT

public:
    explicit DialogAnswerer(QObject *parent = nullptr);

    void answer(QMessageBox::StandardButton button) { _answers.append(button); }

    QStringList seen;

private Q_SLOTS:
    void poll();

private:
    QTimer _timer;
    QList<QMessageBox::StandardButton> _answers;
};

#endif
