// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    /*!
     * The preview of the process, created by the first call with \a parent; later calls ignore \a parent.
     */
    static PreviewDialog *instance(QWidget *parent = nullptr);
    //! Saves the geometry and deletes the printer.
    ~PreviewDialog() override;

    /*! Shows \a html and runs the dialog; returns the result of exec(). */
    int preview(const QString &html);

    //! Restores the geometry from "previewDialog/previewDialogGeometry" when stored.
    void loadSettings();
    //! Stores the geometry under "previewDialog/previewDialogGeometry".
    void saveSettings() const;

    //! The document shown.
    const QString &html() const { return _html; }
    /*! The kept printer; null before the first print. */
    QPrinter *printer() const { return _printer; }

public Q_SLOTS:
    //! Empties the preview.
    void clear();
    /*!
     * Asks for a file name (default "print.html") and writes the document there with an ExportHtmlTask.
     */
    void exportHtml();
    //! Prints the document through the print dialog.
    void print();

protected:
    //! Use instance().
    explicit PreviewDialog(QWidget *parent = nullptr);

    //! The form; owned.
    Ui::PreviewDialog *_ui;
    //! See html().
    QString _html;
    //! See printer(); owned.
    QPrinter *_printer;

    //! The instance of the process, or null.
    static PreviewDialog *_instance;
};

#endif // KVT_PREVIEWDIALOG_H
