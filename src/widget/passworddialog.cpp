// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "passworddialog.h"

#include <QDialogButtonBox>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QShowEvent>

namespace Ui {

// The form is built in code; the object names are part of the interface
// (slots may be connected by name).
class PasswordDialog
{
public:
    QGridLayout *gridLayout;
    QLabel *_userLabelLabel;
    QLineEdit *_userLineEdit;
    QLabel *_passwordLabelLabel;
    QLineEdit *_passwordLineEdit;
    QDialogButtonBox *_buttonBox;

    void setupUi(QDialog *dialog)
    {
        dialog->setObjectName(QStringLiteral("PasswordDialog"));
        dialog->resize(250, 105);
        gridLayout = new QGridLayout(dialog);
        gridLayout->setObjectName(QStringLiteral("gridLayout"));

        _userLabelLabel = new QLabel(dialog);
        _userLabelLabel->setObjectName(QStringLiteral("_userLabelLabel"));
        gridLayout->addWidget(_userLabelLabel, 0, 0);
        _userLineEdit = new QLineEdit(dialog);
        _userLineEdit->setObjectName(QStringLiteral("_userLineEdit"));
        gridLayout->addWidget(_userLineEdit, 0, 1);

        _passwordLabelLabel = new QLabel(dialog);
        _passwordLabelLabel->setObjectName(QStringLiteral("_passwordLabelLabel"));
        gridLayout->addWidget(_passwordLabelLabel, 1, 0);
        _passwordLineEdit = new QLineEdit(dialog);
        _passwordLineEdit->setObjectName(QStringLiteral("_passwordLineEdit"));
        _passwordLineEdit->setEchoMode(QLineEdit::Password);
        gridLayout->addWidget(_passwordLineEdit, 1, 1);

        _buttonBox = new QDialogButtonBox(dialog);
        _buttonBox->setObjectName(QStringLiteral("_buttonBox"));
        _buttonBox->setOrientation(Qt::Horizontal);
        _buttonBox->setStandardButtons(QDialogButtonBox::Ok | QDialogButtonBox::Cancel);
        gridLayout->addWidget(_buttonBox, 2, 0, 1, 2);

        _userLabelLabel->setBuddy(_userLineEdit);
        _passwordLabelLabel->setBuddy(_passwordLineEdit);
        retranslateUi(dialog);
    }

    void retranslateUi(QDialog *dialog)
    {
        dialog->setWindowTitle(::PasswordDialog::tr("Enter login and password"));
        _userLabelLabel->setText(::PasswordDialog::tr("Login:"));
        _passwordLabelLabel->setText(::PasswordDialog::tr("Password:"));
    }
};

} // namespace Ui

PasswordDialog::PasswordDialog(QWidget *parent)
    : QDialog(parent)
    , _ui(new Ui::PasswordDialog)
{
    _ui->setupUi(this);
    connect(_ui->_buttonBox, SIGNAL(accepted()), this, SLOT(accept()));
    connect(_ui->_buttonBox, SIGNAL(rejected()), this, SLOT(reject()));
    connect(_ui->_userLineEdit, SIGNAL(textChanged(QString)), this, SLOT(checkValid()));
    connect(_ui->_passwordLineEdit, SIGNAL(textChanged(QString)), this, SLOT(checkValid()));
    QMetaObject::connectSlotsByName(this);
}

PasswordDialog::~PasswordDialog()
{
    delete _ui;
}

QString PasswordDialog::user() const
{
    return _ui->_userLineEdit->text();
}

QString PasswordDialog::password() const
{
    return _ui->_passwordLineEdit->text();
}

void PasswordDialog::setUser(const QString &user)
{
    if (_ui->_userLineEdit->text() != user)
        _ui->_userLineEdit->setText(user);
}

void PasswordDialog::checkValid()
{
    const bool valid = !_ui->_userLineEdit->text().isEmpty() && !_ui->_passwordLineEdit->text().isEmpty();
    _ui->_buttonBox->button(QDialogButtonBox::Ok)->setEnabled(valid);
}

void PasswordDialog::showEvent(QShowEvent *event)
{
    QDialog::showEvent(event);
    _ui->_userLineEdit->setFocus(Qt::OtherFocusReason);
    _ui->_userLineEdit->selectAll();
}
