#ifndef KVT_PREVIEWDIALOG_H
#define KVT_PREVIEWDIALOG_H

#include "kvtcommon_export.h"

#include <QDialog>
#include <QString>

class QPrinter;

namespace Ui {
class PreviewDialog;
}

/*!
 * The print preview of the application: shows an HTML report read-only and
 * offers to print it or to export it to an HTML file.
 *
 * There is one instance per process, made by the first instance() call; the
 * library never deletes it. Closing the dialog hides and empties it. The
 * printer is made on the first print and kept, so the choices made in the
 * print dialog hold for the next print. The export runs in the background
 * (ExportHtmlTask) and writes the document as given to preview().
 */
class KVTCOMMON_EXPORT PreviewDialog : public QDialog
{
    Q_OBJECT

public:
    static PreviewDialog *instance(QWidget *parent = nullptr);
    ~PreviewDialog() override;

    /*! Shows \a html and runs the dialog; returns the result of exec(). */
    int preview(const QString &html);

    void loadSettings();
    void saveSettings() const;

    const QString &html() const { return _html; }
    /*! The kept printer; null before the first print. */
    QPrinter *printer() const { return _printer; }

public Q_SLOTS:
    void clear();
    void exportHtml();
    void print();

protected:
    explicit PreviewDialog(QWidget *parent = nullptr);

    Ui::PreviewDialog *_ui;
    QString _html;
    QPrinter *_printer;

    static PreviewDialog *_instance;
};

#endif // KVT_PREVIEWDIALOG_H
