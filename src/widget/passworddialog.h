// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PASSWORDDIALOG_H
#define KVT_PASSWORDDIALOG_H

#include "kvtcommon_export.h"

#include <QDialog>

namespace Ui {
class PasswordDialog;
}

/*!
 * Asks for a login and a password. OK is enabled while both are filled in;
 * the state is computed when a text changes, so until then OK keeps the
 * button box's enabled state (call checkValid() or set the texts first to
 * start from the right state).
 *
 * The texts are returned as typed, not trimmed: blanks may belong to a
 * password. Showing the dialog puts the focus on the login with its text
 * selected.
 */
class KVTCOMMON_EXPORT PasswordDialog : public QDialog
{
    Q_OBJECT

public:
    //! Creates the dialog with empty fields.
    explicit PasswordDialog(QWidget *parent = nullptr);
    //! Destroys the dialog.
    ~PasswordDialog() override;

    //! The login as typed.
    QString user() const;
    //! The password as typed.
    QString password() const;
    /*! Sets the login; the same text as shown is left alone, so the cursor
     *  stays and no change is signalled. */
    void setUser(const QString &user);

public Q_SLOTS:
    //! Enables OK exactly while login and password are both filled in.
    void checkValid();

protected:
    //! Puts the focus on the login with its text selected.
    void showEvent(QShowEvent *event) override;

    //! The form; owned.
    Ui::PasswordDialog *_ui;
};

#endif // KVT_PASSWORDDIALOG_H
