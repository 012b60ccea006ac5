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
    explicit ExportHtmlTask(ElementData *data);
    ~ExportHtmlTask() override;

    void run() override;
    void afterRun() override;
};

#endif // KVT_EXPORTHTMLTASK_H
