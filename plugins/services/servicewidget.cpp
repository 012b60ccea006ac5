// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "servicewidget.h"

#include "../shared/admintools.h"
#include "servicesmodule.h"

#include <kvt-common/servicelightelementdata.h>

#include <QAction>
#include <QFontDatabase>
#include <QGridLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QPlainTextEdit>
#include <QToolButton>

ServiceWidget::ServiceWidget(ServicesModule &module, QWidget *parent)
    : ViewEditElementWidget(module, KvtAdmin::mayChangeSystem, parent)
    , _servicesModule(module)
{
    _elementType = Services::serviceType;
    setObjectName(QStringLiteral("ServiceWidget"));
    setWindowTitle(tr("Service"));

    auto *layout = new QGridLayout(this);
    layout->addWidget(new QLabel(tr("State:"), this), 0, 0);
    _stateLabel = new QLabel(this);
    _stateLabel->setObjectName(QStringLiteral("_stateLabel"));
    layout->addWidget(_stateLabel, 0, 1);

    auto *buttons = new QHBoxLayout;
    for (Services::ServiceOperation operation : {Services::StartOperation, Services::StopOperation,
                                                 Services::RestartOperation, Services::ReloadOperation}) {
        auto *button = new QToolButton(this);
        QAction *action = module.action(operation);
        button->setDefaultAction(action);
        button->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
        button->setObjectName(QLatin1Char('_') + action->objectName() + QStringLiteral("ToolButton"));
        buttons->addWidget(button);
    }
    buttons->addStretch(1);
    layout->addLayout(buttons, 1, 0, 1, 2);

    _statusPlainTextEdit = new QPlainTextEdit(this);
    _statusPlainTextEdit->setObjectName(QStringLiteral("_statusPlainTextEdit"));
    _statusPlainTextEdit->setReadOnly(true);
    _statusPlainTextEdit->setLineWrapMode(QPlainTextEdit::NoWrap);
    _statusPlainTextEdit->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
    layout->addWidget(_statusPlainTextEdit, 2, 0, 1, 2);
    layout->setRowStretch(2, 1);
    layout->setColumnStretch(1, 1);
}

void ServiceWidget::setElement(Element *element, ElementWidgetRole role)
{
    const bool same = element == _element && role == _role;
    ViewEditElementWidget::setElement(element, role);
    if (same)
        return;
    _statusPlainTextEdit->clear();
    // The module's actions act on the service shown here.
    _servicesModule.setCurrentService(qobject_cast<ServiceItemElement *>(element));
    showState();
}

void ServiceWidget::afterSuccessfulRead(Element *element, ElementData *data)
{
    // A start or stop outside force reread mode hands over the element's own
    // record, which has no status output: the last output stays.
    if (element == _element && data && data->contains(QStringLiteral("statusText")))
        _statusPlainTextEdit->setPlainText(data->value(QStringLiteral("statusText")).toString());
    showState();
    _servicesModule.updateActions();
    ViewEditElementWidget::afterSuccessfulRead(element, data);
}

void ServiceWidget::blockEditWidget(bool block)
{
    ViewEditElementWidget::blockEditWidget(block);
    // Nothing here is edited: the status stays readable for everybody, and
    // the buttons follow the module's actions (rights and state).
    setEnabled(true);
}

QString ServiceWidget::toolTipText() const
{
    return statusText();
}

QString ServiceWidget::statusText() const
{
    return _statusPlainTextEdit->toPlainText();
}

QString ServiceWidget::stateText() const
{
    return _stateLabel->text();
}

void ServiceWidget::showState()
{
    auto *state = _element ? dynamic_cast<ServiceLightElementData *>(_element->elementData()) : nullptr;
    if (!state || state->textState().isEmpty())
        _stateLabel->setText(tr("unknown"));
    else
        _stateLabel->setText(state->textState());
}
