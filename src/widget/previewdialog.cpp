// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "previewdialog.h"
#include "ui_previewdialog.h"

#include "elementdata.h"
#include "exporthtmltask.h"
#include "taskobserver.h"

#include <QFileDialog>
#include <QPrintDialog>
#include <QPrinter>
#include <QPrinterInfo>
#include <QSettings>

namespace {
const char geometryKey[] = "previewDialog/previewDialogGeometry";
}

PreviewDialog *PreviewDialog::_instance = nullptr;

PreviewDialog *PreviewDialog::instance(QWidget *parent)
{
    if (!_instance)
        _instance = new PreviewDialog(parent);
    return _instance;
}

PreviewDialog::PreviewDialog(QWidget *parent)
    : QDialog(parent)
    , _ui(new Ui::PreviewDialog)
    , _printer(nullptr)
{
    _ui->setupUi(this);
    connect(_ui->buttonBox, SIGNAL(rejected()), this, SLOT(reject()));
    connect(this, SIGNAL(rejected()), this, SLOT(clear()));
    connect(_ui->_printPushButton, SIGNAL(clicked()), this, SLOT(print()));
    connect(_ui->_exportPushButton, SIGNAL(clicked()), this, SLOT(exportHtml()));
    QMetaObject::connectSlotsByName(this);
    loadSettings();
}

PreviewDialog::~PreviewDialog()
{
    saveSettings();
    delete _printer;
    delete _ui;
    if (_instance == this)
        _instance = nullptr;
}

int PreviewDialog::preview(const QString &html)
{
    _html = html;
    _ui->_previewTextEdit->setHtml(html);
    return exec();
}

void PreviewDialog::clear()
{
    _ui->_previewTextEdit->clear();
    _html.clear();
}

void PreviewDialog::print()
{
    if (!_printer)
        _printer = new QPrinter(QPrinterInfo::defaultPrinter(), QPrinter::ScreenResolution);
    QPrintDialog dialog(_printer, this);
    if (dialog.exec() == QDialog::Accepted)
        _ui->_previewTextEdit->print(_printer);
}

void PreviewDialog::exportHtml()
{
    QString fileName = QFileDialog::getSaveFileName(this, tr("Export preview to HTML"),
                                                    QStringLiteral("print.html"), tr("HTML (*.html)"));
    if (fileName.isEmpty())
        return;
    // Case-sensitive on purpose: "report.HTML" becomes "report.HTML.html".
    if (!fileName.endsWith(QLatin1String(".html")))
        fileName += QLatin1String(".html");
    auto *data = new ElementData;
    data->insert(QStringLiteral("filePath"), fileName);
    data->insert(QStringLiteral("htmlText"), _html);
    TaskObserver::instance()->performTask(new ExportHtmlTask(data));
}

void PreviewDialog::loadSettings()
{
    const QByteArray geometry = QSettings().value(QLatin1String(geometryKey)).toByteArray();
    if (!geometry.isEmpty())
        restoreGeometry(geometry);
}

void PreviewDialog::saveSettings() const
{
    QSettings().setValue(QLatin1String(geometryKey), saveGeometry());
}
