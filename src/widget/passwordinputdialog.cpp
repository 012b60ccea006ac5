// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "passwordinputdialog.h"

#include <QDialogButtonBox>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

namespace Ui {

// The form is built in code; the object names are part of the interface
// (slots may be connected by name).
class PasswordInputDialog
{
public:
    QGridLayout *gridLayout;
    QLabel *_passwordLabelLabel;
    QLineEdit *_passwordLineEdit;
    QLabel *_repeatLabelLabel;
    QLineEdit *_repeatLineEdit;
    QDialogButtonBox *_buttonBox;

    void setupUi(QDialog *dialog)
    {
        dialog->setObjectName(QStringLiteral("PasswordInputDialog"));
        dialog->resize(238, 111);
        gridLayout = new QGridLayout(dialog);
        gridLayout->setObjectName(QStringLiteral("gridLayout"));

        _passwordLabelLabel = new QLabel(dialog);
        _passwordLabelLabel->setObjectName(QStringLiteral("_passwordLabelLabel"));
        gridLayout->addWidget(_passwordLabelLabel, 0, 0);
        _passwordLineEdit = new QLineEdit(dialog);
        _passwordLineEdit->setObjectName(QStringLiteral("_passwordLineEdit"));
        _passwordLineEdit->setEchoMode(QLineEdit::Password);
        gridLayout->addWidget(_passwordLineEdit, 0, 1);

        _repeatLabelLabel = new QLabel(dialog);
        _repeatLabelLabel->setObjectName(QStringLiteral("_repeatLabelLabel"));
        gridLayout->addWidget(_repeatLabelLabel, 1, 0);
        _repeatLineEdit = new QLineEdit(dialog);
        _repeatLineEdit->setObjectName(QStringLiteral("_repeatLineEdit"));
        _repeatLineEdit->setEchoMode(QLineEdit::Password);
        gridLayout->addWidget(_repeatLineEdit, 1, 1);

        // Row 2 stays empty and takes the spare height.
        gridLayout->setRowStretch(2, 1);

        _buttonBox = new QDialogButtonBox(dialog);
        _buttonBox->setObjectName(QStringLiteral("_buttonBox"));
        _buttonBox->setOrientation(Qt::Horizontal);
        _buttonBox->setStandardButtons(QDialogButtonBox::Ok | QDialogButtonBox::Cancel);
        gridLayout->addWidget(_buttonBox, 3, 0, 1, 2);
        gridLayout->setColumnStretch(1, 1);

        _passwordLabelLabel->setBuddy(_passwordLineEdit);
        _repeatLabelLabel->setBuddy(_repeatLineEdit);
        retranslateUi(dialog);
    }

    void retranslateUi(QDialog *dialog)
    {
        dialog->setWindowTitle(::PasswordInputDialog::tr("Change password"));
        _passwordLabelLabel->setText(::PasswordInputDialog::tr("Password:"));
        _repeatLabelLabel->setText(::PasswordInputDialog::tr("Repeat:"));
    }
};

} // namespace Ui

PasswordInputDialog::PasswordInputDialog(QWidget *parent)
    : QDialog(parent)
    , _ui(new Ui::PasswordInputDialog)
{
    _ui->setupUi(this);
    connect(_ui->_buttonBox, SIGNAL(accepted()), this, SLOT(accept()));
    connect(_ui->_buttonBox, SIGNAL(rejected()), this, SLOT(reject()));
    connect(_ui->_passwordLineEdit, SIGNAL(textChanged(QString)), this, SLOT(validate()));
    connect(_ui->_repeatLineEdit, SIGNAL(textChanged(QString)), this, SLOT(validate()));
    QMetaObject::connectSlotsByName(this);
}

PasswordInputDialog::~PasswordInputDialog()
{
    delete _ui;
}

QString PasswordInputDialog::password() const
{
    return _ui->_passwordLineEdit->text();
}

void PasswordInputDialog::validate()
{
    const QString password = _ui->_passwordLineEdit->text();
    // Exact comparison: a password of blanks is a password.
    const bool valid = !password.isEmpty() && password == _ui->_repeatLineEdit->text();
    _ui->_buttonBox->button(QDialogButtonBox::Ok)->setEnabled(valid);
}

int PasswordInputDialog::exec()
{
    return QDialog::exec();
}
