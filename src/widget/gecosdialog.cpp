// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "gecosdialog.h"

#include <QDialogButtonBox>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QRegExpValidator>

namespace Ui {

// The form is built in code; the object names are part of the interface
// (slots may be connected by name). The button box is "buttonBox", without
// the underscore of the other dialogs, as callers know it.
class GecosDialog
{
public:
    QGridLayout *gridLayout;
    QLabel *_nameLabelLabel;
    QLineEdit *_nameLineEdit;
    QLabel *_roomLabelLabel;
    QLineEdit *_roomLineEdit;
    QLabel *_phoneLabelLabel;
    QLineEdit *_phoneLineEdit;
    QLabel *_otherLabelLabel;
    QLineEdit *_otherLineEdit;
    QDialogButtonBox *buttonBox;
    QRegExpValidator *validator; // owned by the dialog

    QLineEdit *field(int i) const
    {
        QLineEdit *const fields[] = {_nameLineEdit, _roomLineEdit, _phoneLineEdit, _otherLineEdit};
        return fields[i];
    }

    void setupUi(QDialog *dialog)
    {
        dialog->setObjectName(QStringLiteral("GecosDialog"));
        dialog->resize(341, 178);
        dialog->setModal(true);
        gridLayout = new QGridLayout(dialog);
        gridLayout->setObjectName(QStringLiteral("gridLayout"));

        const char *const names[][2] = {{"_nameLabelLabel", "_nameLineEdit"},
                                        {"_roomLabelLabel", "_roomLineEdit"},
                                        {"_phoneLabelLabel", "_phoneLineEdit"},
                                        {"_otherLabelLabel", "_otherLineEdit"}};
        QLabel **labels[] = {&_nameLabelLabel, &_roomLabelLabel, &_phoneLabelLabel, &_otherLabelLabel};
        QLineEdit **edits[] = {&_nameLineEdit, &_roomLineEdit, &_phoneLineEdit, &_otherLineEdit};
        for (int row = 0; row < 4; ++row) {
            QLabel *label = new QLabel(dialog);
            label->setObjectName(QLatin1String(names[row][0]));
            gridLayout->addWidget(label, row, 0);
            QLineEdit *edit = new QLineEdit(dialog);
            edit->setObjectName(QLatin1String(names[row][1]));
            gridLayout->addWidget(edit, row, 1);
            label->setBuddy(edit);
            *labels[row] = label;
            *edits[row] = edit;
        }
        // Row 4 stays empty and takes the spare height.
        gridLayout->setRowStretch(4, 1);

        buttonBox = new QDialogButtonBox(dialog);
        buttonBox->setObjectName(QStringLiteral("buttonBox"));
        buttonBox->setOrientation(Qt::Horizontal);
        buttonBox->setStandardButtons(QDialogButtonBox::Ok | QDialogButtonBox::Cancel);
        gridLayout->addWidget(buttonBox, 5, 0, 1, 2);
        gridLayout->setColumnStretch(1, 1);

        // A comma separates the sub-fields, so none may be typed into one.
        validator = new QRegExpValidator(QRegExp(QStringLiteral("[^,]*"), Qt::CaseSensitive, QRegExp::RegExp),
                                         dialog);
        for (int i = 0; i < 4; ++i)
            field(i)->setValidator(validator);
        retranslateUi(dialog);
    }

    void retranslateUi(QDialog *dialog)
    {
        dialog->setWindowTitle(::GecosDialog::tr("GECOS"));
        _nameLabelLabel->setText(::GecosDialog::tr("Full name:"));
        _roomLabelLabel->setText(::GecosDialog::tr("Room number:"));
        _phoneLabelLabel->setText(::GecosDialog::tr("Telephone:"));
        _otherLabelLabel->setText(::GecosDialog::tr("Other:"));
    }
};

} // namespace Ui

GecosDialog::GecosDialog(QWidget *parent)
    : QDialog(parent)
    , _ui(new Ui::GecosDialog)
{
    _ui->setupUi(this);
    connect(_ui->buttonBox, SIGNAL(accepted()), this, SLOT(accept()));
    connect(_ui->buttonBox, SIGNAL(rejected()), this, SLOT(reject()));
    QMetaObject::connectSlotsByName(this);
}

GecosDialog::~GecosDialog()
{
    delete _ui;
}

QString GecosDialog::gecos() const
{
    QString result;
    for (int i = 0; i < 4; ++i) {
        const QString text = _ui->field(i)->text().simplified();
        if (i > 0)
            result += QLatin1Char(',');
        // Every non-empty sub-field, the first one too, follows one blank.
        if (!text.isEmpty())
            result += QLatin1Char(' ') + text;
    }
    return result;
}

void GecosDialog::setGecos(const QString &gecos)
{
    clear();
    // Empty parts are kept: ",,555" puts 555 in the telephone.
    const QStringList parts = gecos.split(QLatin1Char(','));
    for (int i = 0; i < 4 && i < parts.size(); ++i)
        _ui->field(i)->setText(parts.at(i).simplified());
}

void GecosDialog::clear()
{
    for (int i = 0; i < 4; ++i)
        _ui->field(i)->clear();
}

int GecosDialog::exec()
{
    _ui->_nameLineEdit->setFocus(Qt::OtherFocusReason);
    return QDialog::exec();
}
