// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_GECOSDIALOG_H
#define KVT_GECOSDIALOG_H

#include "kvtcommon_export.h"

#include <QDialog>

namespace Ui {
class GecosDialog;
}

/*!
 * Edits the four comma-separated sub-fields of a user's GECOS field: full
 * name, room number, telephone and other. No comma can be typed or pasted
 * into a sub-field.
 *
 * gecos() writes every non-empty sub-field, the first included, after one
 * blank: " John Smith,, 555," for a name and a telephone. The blanks are
 * part of the format that existing account data uses; setGecos() drops them
 * again, so setGecos(gecos()) keeps the four fields.
 */
class KVTCOMMON_EXPORT GecosDialog : public QDialog
{
    Q_OBJECT

public:
    //! Creates the dialog with empty sub-fields.
    explicit GecosDialog(QWidget *parent = nullptr);
    //! Destroys the dialog.
    ~GecosDialog() override;

    /*! The four sub-fields, white space simplified, joined by exactly three
     *  commas. */
    QString gecos() const;
    /*! Fills the sub-fields from the first four comma-separated parts of
     *  \a gecos; further parts are ignored, missing ones leave their field
     *  empty. */
    void setGecos(const QString &gecos);
    //! Empties the four sub-fields.
    void clear();

public Q_SLOTS:
    //! Runs the dialog with the focus on the full name.
    int exec() override;

protected:
    //! The form; owned.
    Ui::GecosDialog *_ui;
};

#endif // KVT_GECOSDIALOG_H
