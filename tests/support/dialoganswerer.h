// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TEST_DIALOGANSWERER_H
#define KVT_TEST_DIALOGANSWERER_H

#include <QMessageBox>
#include <QObject>
#include <QStringList>
#include <QTimer>

#include <functional>

class QDialog;

/*!
 * Answers the modal dialogs a test provokes, so that no test waits on one.
 * While it lives it polls QApplication::activeModalWidget(); the task
 * observer's dialogs are left alone.
 *
 * - A message box is recorded as "<title>|<text>|<buttons>" (buttons as the
 *   sum of their QMessageBox::StandardButton values) and answered with the
 *   next queued button, or closed with Escape when none is queued.
 * - A file dialog is recorded as "file:<title>" and given the next queued
 *   file name, or cancelled when none is queued.
 * - Any other dialog is recorded as "dialog:<class name>", shown to inspect
 *   when set, and accepted when the next queued button is Ok, Yes or Save,
 *   rejected otherwise.
 */
class DialogAnswerer : public QObject
{
    Q_OBJECT

public:
    explicit DialogAnswerer(QObject *parent = nullptr);

    void answer(QMessageBox::StandardButton button) { _answers.append(button); }
    void answerFile(const QString &fileName) { _files.append(fileName); }

    QStringList seen;
    std::function<void(QDialog *)> inspect;

private Q_SLOTS:
    void poll();

private:
    QTimer _timer;
    QList<QMessageBox::StandardButton> _answers;
    QStringList _files;
};

#endif
