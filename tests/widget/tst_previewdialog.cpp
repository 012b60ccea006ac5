// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/previewdialog.h>
#include <kvt-common/taskobserverdialog.h>

#include "../task/taskprobe.h"
#include "dialoganswerer.h"

#include <QPrinter>
#include <QTemporaryDir>
#include <QTextEdit>
#include <QtTest>

namespace {

// A preview that returns from preview() at once instead of running.
class QuietPreview : public PreviewDialog
{
public:
    QuietPreview() : PreviewDialog(nullptr) {}
    int exec() override { return QDialog::Accepted; }
};

} // namespace

class PreviewDialogTest : public QObject
{
    Q_OBJECT

    Workers workers;

private Q_SLOTS:
    void initTestCase() { workers.start(1); }
    void cleanupTestCase()
    {
        workers.stop();
        delete PreviewDialog::instance();
        delete TaskObserver::instance();
    }

    void closingEmpties()
    {
        PreviewDialog *dialog = PreviewDialog::instance();
        auto *text = dialog->findChild<QTextEdit *>(QStringLiteral("_previewTextEdit"));
        QStringList shown;
        DialogAnswerer answerer;
        answerer.inspect = [&](QDialog *) { shown.append(text->toPlainText()); };
        QCOMPARE(dialog->preview(QStringLiteral("<p>first</p>")), int(QDialog::Rejected));
        QCOMPARE(dialog->html(), QString());
        QCOMPARE(text->toPlainText(), QString());
        dialog->preview(QStringLiteral("<p>second</p>"));
        QCOMPARE(shown, (QStringList{"first", "second"}));
    }

    void printKeepsPrinter()
    {
        QuietPreview preview;
        preview.preview(QStringLiteral("<h1>Report</h1><p>printed</p>"));
        DialogAnswerer answerer;
        answerer.answer(QMessageBox::Cancel);
        preview.print();
        QCOMPARE(answerer.seen, QStringList{"dialog:QPrintDialog"});
        QPrinter *printer = preview.printer();
        QVERIFY(printer);

        // The choices stay with the kept printer for the next print.
        QTemporaryDir dir;
        const QString pdf = dir.filePath(QStringLiteral("report.pdf"));
        printer->setOutputFormat(QPrinter::PdfFormat);
        printer->setOutputFileName(pdf);
        answerer.answer(QMessageBox::Ok);
        preview.print();
        QCOMPARE(preview.printer(), printer);
        QFile file(pdf);
        QVERIFY(file.open(QIODevice::ReadOnly));
        QCOMPARE(file.read(5), QByteArray("%PDF-"));
    }

    void exportHtml_data()
    {
        QTest::addColumn<QString>("chosen");
        QTest::addColumn<QString>("written");

        QTest::newRow("with extension") << "page.html" << "page.html";
        // The extension is compared case-sensitively: any other ending gets one.
        QTest::newRow("upper-case extension") << "PAGE.HTML" << "PAGE.HTML.html";
        QTest::newRow("cancelled") << "" << "";
    }
    void exportHtml()
    {
        QFETCH(QString, chosen);
        QFETCH(QString, written);

        // Written as given, not as the text edit would write it back.
        const QString html = QStringLiteral("<p>Отчёт   &amp;  <b>x</b></p>");
        QuietPreview preview;
        preview.preview(html);
        QTemporaryDir dir;
        DialogAnswerer answerer;
        if (!chosen.isEmpty())
            answerer.answerFile(dir.filePath(chosen));
        preview.exportHtml();
        QTRY_COMPARE_WITH_TIMEOUT(TaskObserver::instance()->runningCount(), 0, 10000);
        QCOMPARE(answerer.seen, QStringList{"file:Export preview to HTML"});
        QCOMPARE(QDir(dir.path()).entryList(QDir::Files), written.isEmpty() ? QStringList{} : QStringList{written});
        if (!written.isEmpty()) {
            QFile file(dir.filePath(written));
            QVERIFY(file.open(QIODevice::ReadOnly));
            QCOMPARE(file.readAll(), html.toUtf8());
        }
    }
};

QTEST_MAIN(PreviewDialogTest)
#include "tst_previewdialog.moc"
