// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PASSWORDINPUTDIALOG_H
#define KVT_PASSWORDINPUTDIALOG_H

#include "kvtcommon_export.h"

#include <QDialog>

namespace Ui {
class PasswordInputDialog;
}

/*!
 * Asks for a new password twice. OK is enabled while the password is not
 * empty and the repetition is exactly the same text; the state is computed
 * when a text changes (call validate() to compute it before that).
 */
class KVTCOMMON_EXPORT PasswordInputDialog : public QDialog
{
    Q_OBJECT

public:
    //! Creates the dialog with empty fields.
    explicit PasswordInputDialog(QWidget *parent = nullptr);
    //! Destroys the dialog.
    ~PasswordInputDialog() override;

    //! The new password as typed.
    QString password() const;

public Q_SLOTS:
    //! Enables OK exactly while the password is not empty and repeated exactly.
    void validate();
    //! Runs the dialog (QDialog::exec()); the fields keep what they hold.
    int exec() override;

protected:
    //! The form; owned.
    Ui::PasswordInputDialog *_ui;
};

#endif // KVT_PASSWORDINPUTDIALOG_H
