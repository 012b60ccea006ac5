#include <kvt-common/previewdialog.h>
#include <kvt-common/taskobserverdialog.h>

#include "../task/taskprobe.h"
#include "dialoganswerer.h"

#include <QDialogButtonBox>
#include <QPrinter>
#include <QPushButton>
#include <QSettings>
#include <QTemporaryDir>
#include <QTextEdit>
#include <QtTest>

namespace {

const char geometryKey[] = "previewDialog/previewDialogGeometry";

// A preview that returns from preview() at once instead of running.
class QuietPreview : public PreviewDialog
{
public:
    QuietPreview() : PreviewDialog(nullptr) {}
    int exec() override { return QDialog::Accepted; }
    QTextEdit *textEdit() const { return findChild<QTextEdit *>(QStringLiteral("_previewTextEdit")); }
};

} // namespace

class PreviewDialogTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void cleanupTestCase();

    void singleInstanceWithForm();
    void closingEmpties_data();
    void closingEmpties();
    void geometryKept();
    void printKeepsPrinter();
    void exportHtml_data();
    void exportHtml();

private:
    Workers workers;
    QTemporaryDir dir;
};

void PreviewDialogTest::initTestCase()
{
    workers.start(1);
}

void PreviewDialogTest::cleanupTestCase()
{
    workers.stop();
    delete PreviewDialog::instance();
    delete TaskObserver::instance();
}

void PreviewDialogTest::singleInstanceWithForm()
{
    QVERIFY(!QSettings().contains(QLatin1String(geometryKey)));
    QWidget other;
    PreviewDialog *dialog = PreviewDialog::instance();
    QCOMPARE(PreviewDialog::instance(&other), dialog);
    QVERIFY(!dialog->parent());
    QCOMPARE(dialog->size(), QSize(400, 300));
    QCOMPARE(dialog->windowTitle(), QStringLiteral("Print preview"));
    QVERIFY(dialog->isModal());
    QVERIFY(dialog->findChild<QTextEdit *>(QStringLiteral("_previewTextEdit"))->isReadOnly());
    QCOMPARE(dialog->findChild<QPushButton *>(QStringLiteral("_exportPushButton"))->text(), QStringLiteral("Export"));
    QCOMPARE(dialog->findChild<QPushButton *>(QStringLiteral("_printPushButton"))->text(), QStringLiteral("Print"));
    QCOMPARE(dialog->findChild<QDialogButtonBox *>(QStringLiteral("buttonBox"))->standardButtons(),
             QDialogButtonBox::Cancel);
    QVERIFY(!dialog->printer());
}

void PreviewDialogTest::closingEmpties_data()
{
    QTest::addColumn<bool>("cancelButton");
    QTest::newRow("cancel") << true;
    QTest::newRow("escape") << false;
}

void PreviewDialogTest::closingEmpties()
{
    QFETCH(bool, cancelButton);

    PreviewDialog *dialog = PreviewDialog::instance();
    auto *text = dialog->findChild<QTextEdit *>(QStringLiteral("_previewTextEdit"));
    QStringList shown;
    DialogAnswerer answerer;
    answerer.inspect = [&](QDialog *) {
        shown.append(text->toPlainText());
        if (cancelButton)
            dialog->findChild<QDialogButtonBox *>()->button(QDialogButtonBox::Cancel)->click();
    };
    QCOMPARE(dialog->preview(QStringLiteral("<p>first</p>")), int(QDialog::Rejected));
    QCOMPARE(dialog->html(), QString());
    QCOMPARE(text->toPlainText(), QString());
    dialog->preview(QStringLiteral("<p>second</p>"));
    QCOMPARE(shown, (QStringList{"first", "second"}));
}

void PreviewDialogTest::geometryKept()
{
    PreviewDialog *dialog = PreviewDialog::instance();
    dialog->resize(520, 330);
    delete dialog;
    QVERIFY(!QSettings().value(QLatin1String(geometryKey)).toByteArray().isEmpty());
    PreviewDialog *again = PreviewDialog::instance();
    QVERIFY(again != nullptr);
    QCOMPARE(again->size(), QSize(520, 330));
}

void PreviewDialogTest::printKeepsPrinter()
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
    const QString pdf = dir.filePath(QStringLiteral("report.pdf"));
    printer->setOutputFormat(QPrinter::PdfFormat);
    printer->setOutputFileName(pdf);
    answerer.answer(QMessageBox::Ok);
    preview.print();
    QCOMPARE(preview.printer(), printer);
    QCOMPARE(printer->outputFileName(), pdf);
    QFile file(pdf);
    QVERIFY(file.open(QIODevice::ReadOnly));
    QVERIFY(file.read(5) == "%PDF-");
}

void PreviewDialogTest::exportHtml_data()
{
    QTest::addColumn<QString>("chosen");
    QTest::addColumn<QString>("written");

    QTest::newRow("without extension") << "plain" << "plain.html";
    QTest::newRow("with extension") << "page.html" << "page.html";
    // The extension is compared case-sensitively.
    QTest::newRow("upper-case extension") << "PAGE.HTML" << "PAGE.HTML.html";
    QTest::newRow("cancelled") << "" << "";
}

void PreviewDialogTest::exportHtml()
{
    QFETCH(QString, chosen);
    QFETCH(QString, written);

    // Written as given, not as the text edit would write it back.
    const QString html = QStringLiteral("<p>Отчёт   &amp;  <b>x</b></p>");
    QuietPreview preview;
    preview.preview(html);
    const QStringList before = QDir(dir.path()).entryList(QDir::Files);

    DialogAnswerer answerer;
    if (!chosen.isEmpty())
        answerer.answerFile(dir.filePath(chosen));
    preview.exportHtml();
    QTRY_COMPARE_WITH_TIMEOUT(TaskObserver::instance()->runningCount(), 0, 10000);
    QCOMPARE(answerer.seen, QStringList{"file:Export preview to HTML"});
    if (written.isEmpty()) {
        QCOMPARE(QDir(dir.path()).entryList(QDir::Files), before);
        return;
    }
    QFile file(dir.filePath(written));
    QVERIFY(file.open(QIODevice::ReadOnly));
    QCOMPARE(file.readAll(), html.toUtf8());
    QVERIFY(file.remove());
}

QTEST_MAIN(PreviewDialogTest)
#include "tst_previewdialog.moc"
