#ifndef KVT_BLOCKDIALOG_H
#define KVT_BLOCKDIALOG_H

#include "kvtcommon_export.h"

#include <QDialog>

/*!
 * A small modal dialog that keeps the user from starting more work while a
 * task's first second passes. It deletes itself when closed.
 */
class KVTCOMMON_EXPORT BlockDialog : public QDialog
{
    Q_OBJECT

public:
    //! Creates the modal dialog; it deletes itself when closed.
    explicit BlockDialog(QWidget *parent = nullptr);
};

#endif // KVT_BLOCKDIALOG_H
