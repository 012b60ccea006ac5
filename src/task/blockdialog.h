// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_BLOCKDIALOG_H
#define KVT_BLOCKDIALOG_H

#include "kvtcommon_export.h"

#include <QDialog>

/*!
 * A modal dialog that keeps the user from starting more work while a task's
 * first second passes. It deletes itself when closed.
 *
 * It is not meant to be seen: it has no frame and no content and is one
 * transparent pixel large; while it is shown the application shows the busy
 * cursor.
 */
class KVTCOMMON_EXPORT BlockDialog : public QDialog
{
    Q_OBJECT

public:
    //! Creates the modal dialog; it deletes itself when closed.
    explicit BlockDialog(QWidget *parent = nullptr);
};

#endif // KVT_BLOCKDIALOG_H
