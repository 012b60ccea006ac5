// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#include "keywidget.h"

#include "conffileelements.h"
#include "ui_keywidget.h"

#include <kvt-common/elementdata.h>
#include <kvt-common/module.h>

#include <QSignalBlocker>

KeyWidget::KeyWidget(Module &module, QWidget *parent)
    : ViewEditElementWidget(module, Module::defaultTrue, parent)
    , _ui(new Ui::KeyWidget)
{
    _ui->setupUi(this);
    _elementType = ConfFileTypes::key();
    // Long values stay whole: the line is written back from this field.
    _ui->_valueLineEdit->setMaxLength(ConfFileFormat::MaxEditableValue);
    _ui->_commentLineEdit->setMaxLength(ConfFileFormat::MaxEditableValue);
    for (QLineEdit *edit : {_ui->_keyLineEdit, _ui->_valueLineEdit, _ui->_commentLineEdit})
        connect(edit, SIGNAL(textEdited(QString)), this, SLOT(edited()));
}

KeyWidget::~KeyWidget()
{
    delete _ui;
}

void KeyWidget::setCreateTarget(FileElement *file)
{
    _createTarget = file;
}

FileElement *KeyWidget::createTarget() const
{
    return _createTarget;
}

QString KeyWidget::toolTipText() const
{
    return caption();
}

QString KeyWidget::caption() const
{
    if (_role == CreateElementRole)
        return _createTarget ? tr("New key in %1").arg(_createTarget->path()) : tr("New key");
    auto *key = qobject_cast<KeyElement *>(_element);
    if (!key)
        return QString();
    return key->file() ? QStringLiteral("%1 - %2").arg(key->title(), key->file()->path()) : key->title();
}

void KeyWidget::beforeCreation()
{
    const QSignalBlocker blocker(this);
    _ui->_keyLineEdit->clear();
    _ui->_valueLineEdit->clear();
    _ui->_commentLineEdit->clear();
    _ui->_keyLineEdit->setReadOnly(false);
    _ui->_lineLabel->setText(_createTarget ? tr("appended to %1").arg(_createTarget->path()) : QString());
    showProblem();
    _ui->_keyLineEdit->setFocus();
}

ElementData *KeyWidget::exportElementData() const
{
    auto *data = new ElementData;
    data->setName(_ui->_keyLineEdit->text());
    data->insert(QStringLiteral("value"), _ui->_valueLineEdit->text());
    data->insert(QStringLiteral("comment"), _ui->_commentLineEdit->text());
    return data;
}

void KeyWidget::afterSuccessfulRead(Element *element, ElementData *data)
{
    if (element == _element && _role == EditElementRole && data) {
        _ui->_keyLineEdit->setText(data->name());
        _ui->_keyLineEdit->setReadOnly(true);
        _ui->_valueLineEdit->setText(data->value(QStringLiteral("value")).toString());
        _ui->_commentLineEdit->setText(data->value(QStringLiteral("comment")).toString());
        _ui->_lineLabel->setText(tr("%1 of %2")
                                     .arg(data->value(QStringLiteral("line")).toInt())
                                     .arg(data->value(QStringLiteral("file")).toString()));
    }
    ViewEditElementWidget::afterSuccessfulRead(element, data);
    showProblem();
}

void KeyWidget::reset()
{
    ViewEditElementWidget::reset();
    _ui->_keyLineEdit->clear();
    _ui->_valueLineEdit->clear();
    _ui->_commentLineEdit->clear();
    _ui->_lineLabel->clear();
    _ui->_messageLabel->clear();
}

bool KeyWidget::isContentValid() const
{
    return problem().isEmpty();
}

void KeyWidget::blockEditWidget(bool block)
{
    ViewEditElementWidget::blockEditWidget(block);
    // A line that cannot be written back unchanged is shown, not edited.
    auto *key = qobject_cast<KeyElement *>(_element);
    if (!block && key && !key->entry().problem.isEmpty()) {
        _ui->_valueLineEdit->setReadOnly(true);
        _ui->_commentLineEdit->setReadOnly(true);
    } else {
        _ui->_valueLineEdit->setReadOnly(false);
        _ui->_commentLineEdit->setReadOnly(false);
    }
}

void KeyWidget::edited()
{
    changeContent();
    showProblem();
}

QString KeyWidget::problem() const
{
    if (_role == CreateElementRole) {
        const QString keyProblem = ConfFileFormat::keyProblem(_ui->_keyLineEdit->text());
        if (!keyProblem.isEmpty())
            return keyProblem;
    }
    if (auto *key = qobject_cast<KeyElement *>(_element)) {
        if (!key->entry().problem.isEmpty())
            return key->entry().problem;
    }
    const QString valueProblem = ConfFileFormat::valueProblem(_ui->_valueLineEdit->text());
    if (!valueProblem.isEmpty())
        return valueProblem;
    return ConfFileFormat::commentProblem(_ui->_commentLineEdit->text());
}

void KeyWidget::showProblem()
{
    // Before anything is typed in the create role, no reproach.
    const bool untouched = _role == CreateElementRole && _ui->_keyLineEdit->text().isEmpty();
    _ui->_messageLabel->setText(untouched ? QString() : problem());
}
