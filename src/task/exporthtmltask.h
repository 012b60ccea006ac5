// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_EXPORTHTMLTASK_H
#define KVT_EXPORTHTMLTASK_H

#include "abstracttask.h"

#include <QCoreApplication>

/*!
 * Writes the record's "htmlText" as UTF-8 to the file named by its
 * "filePath", replacing the file's content. A file that cannot be opened
 * fails the task with its name, error code and error text.
 */
class KVTCOMMON_EXPORT ExportHtmlTask : public AbstractTask
{
    Q_DECLARE_TR_FUNCTIONS(ExportHtmlTask)

public:
    /*!
     * Creates the task with \a data (owned) holding "htmlText" and "filePath"; its name is "Export to HTML".
     */
    explicit ExportHtmlTask(ElementData *data);
    //! Destroys the task and its record.
    ~ExportHtmlTask() override;

    //! Writes the file in the worker thread.
    void run() override;
    //! Does nothing.
    void afterRun() override;
};

#endif // KVT_EXPORTHTMLTASK_H
