// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "accountswidgets.h"

#include "../shared/admintools.h"
#include "accountsmodule.h"

#include <kvt-common/choicetreenodeproxymodel.h>
#include <kvt-common/choicewidget.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/gecosdialog.h>
#include <kvt-common/passwordinputdialog.h>
#include <kvt-common/treenodemodel.h>

#include <QFormLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>

namespace {

// Roles of their own for the ticked and blocked state of a group, answered
// as booleans by the choice proxy.
const int choiceRole = Qt::UserRole + 100;
const int blockRole = Qt::UserRole + 101;

QLabel *addField(QFormLayout *form, QMap<QString, QLabel *> &labels, const QString &key,
                 const QString &text, QWidget *parent)
{
    auto *label = new QLabel(parent);
    label->setObjectName(QLatin1Char('_') + key + QStringLiteral("Label"));
    label->setTextInteractionFlags(Qt::TextSelectableByMouse);
    form->addRow(text, label);
    labels.insert(key, label);
    return label;
}

QStringList sortedList(const QSet<QString> &set)
{
    QStringList list(set.begin(), set.end());
    list.sort();
    return list;
}

} // namespace

UserWidget::UserWidget(AccountsModule &module, QWidget *parent)
    : ViewEditElementWidget(module, KvtAdmin::mayChangeSystem, parent)
    , _accountsModule(module)
{
    _elementType = Accounts::userType;
    setObjectName(QStringLiteral("UserWidget"));
    setWindowTitle(tr("User"));

    auto *layout = new QVBoxLayout(this);
    auto *form = new QFormLayout;
    addField(form, _labels, QStringLiteral("user"), tr("Login:"), this);
    addField(form, _labels, QStringLiteral("uid"), tr("UID:"), this);
    addField(form, _labels, QStringLiteral("primaryGroup"), tr("Primary group:"), this);
    addField(form, _labels, QStringLiteral("home"), tr("Home:"), this);
    addField(form, _labels, QStringLiteral("shell"), tr("Shell:"), this);
    addField(form, _labels, QStringLiteral("fullName"), tr("Full name:"), this);
    addField(form, _labels, QStringLiteral("room"), tr("Room number:"), this);
    addField(form, _labels, QStringLiteral("phone"), tr("Telephone:"), this);
    addField(form, _labels, QStringLiteral("other"), tr("Other:"), this);
    addField(form, _labels, QStringLiteral("groups"), tr("Groups:"), this)->setWordWrap(true);
    layout->addLayout(form);

    auto *buttons = new QHBoxLayout;
    _gecosPushButton = new QPushButton(tr("Change user information..."), this);
    _gecosPushButton->setObjectName(QStringLiteral("_gecosPushButton"));
    _passwordPushButton = new QPushButton(tr("Change password..."), this);
    _passwordPushButton->setObjectName(QStringLiteral("_passwordPushButton"));
    buttons->addWidget(_gecosPushButton);
    buttons->addWidget(_passwordPushButton);
    buttons->addStretch(1);
    layout->addLayout(buttons);

    // The groups to choose from are the module's group elements.
    _groupModel = new TreeNodeModel(module.groups(), this);
    _choiceModel = new ChoiceTreeNodeProxyModel(0, choiceRole, blockRole, this);
    _choiceModel->setSourceModel(_groupModel);
    _groupsChoiceWidget = new ChoiceWidget(this);
    _groupsChoiceWidget->setObjectName(QStringLiteral("_groupsChoiceWidget"));
    _groupsChoiceWidget->setTitle(tr("Member of"));
    _groupsChoiceWidget->setChoiceModel(_choiceModel);
    layout->addWidget(_groupsChoiceWidget, 1);

    auto *apply = new QHBoxLayout;
    _applyPushButton = new QPushButton(tr("Apply"), this);
    _applyPushButton->setObjectName(QStringLiteral("_applyPushButton"));
    _applyPushButton->setEnabled(false);
    apply->addStretch(1);
    apply->addWidget(_applyPushButton);
    layout->addLayout(apply);

    connect(_gecosPushButton, SIGNAL(clicked()), this, SLOT(changeGecos()));
    connect(_passwordPushButton, SIGNAL(clicked()), this, SLOT(changePassword()));
    // applyContentChanges() is a virtual function, not a slot.
    connect(_applyPushButton, &QPushButton::clicked, this, [this] { applyContentChanges(); });
    connect(_choiceModel, SIGNAL(stateChanged()), this, SLOT(choiceChanged()));
    connect(this, &ViewEditElementWidget::contentChanged, _applyPushButton,
            [this](int state) { _applyPushButton->setEnabled(state == 3); });
}

void UserWidget::setElement(Element *element, ElementWidgetRole role)
{
    ViewEditElementWidget::setElement(element, role);
    // The groups are offered once they are listed.
    if (_element && _accountsModule.groups()->canFetchMore())
        _accountsModule.groups()->fetchMore();
}

ElementData *UserWidget::exportElementData() const
{
    auto *data = new ElementData;
    data->insert(QStringLiteral("addGroups"), sortedList(_choiceModel->addNames()));
    data->insert(QStringLiteral("removeGroups"), sortedList(_choiceModel->removeNames()));
    return data;
}

void UserWidget::afterSuccessfulRead(Element *element, ElementData *data)
{
    if (element == _element && data && data->contains(QStringLiteral("groups"))) {
        for (const QString &key : {QStringLiteral("user"), QStringLiteral("uid"), QStringLiteral("primaryGroup"),
                                   QStringLiteral("home"), QStringLiteral("shell")})
            _labels.value(key)->setText(data->value(key).toString());
        _gecos = data->value(QStringLiteral("gecos")).toString();
        const QStringList fields = Accounts::gecosFields(_gecos);
        _labels.value(QStringLiteral("fullName"))->setText(fields.at(0));
        _labels.value(QStringLiteral("room"))->setText(fields.at(1));
        _labels.value(QStringLiteral("phone"))->setText(fields.at(2));
        _labels.value(QStringLiteral("other"))->setText(fields.at(3));
        const QStringList groups = data->value(QStringLiteral("groups")).toStringList();
        _labels.value(QStringLiteral("groups"))->setText(groups.join(QStringLiteral(", ")));
        // The primary group is not a membership that can be taken away here.
        _filling = true;
        _choiceModel->setCheckedBlockedNames(QSet<QString>(groups.begin(), groups.end()),
                                             {data->value(QStringLiteral("primaryGroup")).toString()});
        _choiceModel->clearAddRemoveNames();
        _filling = false;
    }
    ViewEditElementWidget::afterSuccessfulRead(element, data);
}

void UserWidget::blockEditWidget(bool block)
{
    ViewEditElementWidget::blockEditWidget(block);
    // What the user reads stays readable; only the changing controls follow
    // the rights.
    setEnabled(true);
    _gecosPushButton->setEnabled(!_editBlocked);
    _passwordPushButton->setEnabled(!_editBlocked);
    _groupsChoiceWidget->setChoiceEnabled(!_editBlocked);
    if (_editBlocked)
        _applyPushButton->setEnabled(false);
}

QString UserWidget::toolTipText() const
{
    return _element ? _element->toolTipText() : QString();
}

QString UserWidget::fieldText(const QString &key) const
{
    QLabel *label = _labels.value(key);
    return label ? label->text() : QString();
}

void UserWidget::choiceChanged()
{
    if (!_filling && !_editBlocked)
        changeContent();
}

void UserWidget::changeGecos()
{
    if (!_element || _editBlocked)
        return;
    GecosDialog dialog(this);
    dialog.setGecos(_gecos);
    QPointer<Element> element(_element);
    if (dialog.exec() != QDialog::Accepted || !element)
        return;
    auto *data = new ElementData; // taken over by the task
    data->insert(QStringLiteral("gecos"), dialog.gecos());
    element->performOperation(Accounts::ChangeGecosOperation, data, 0);
}

void UserWidget::changePassword()
{
    if (!_element || _editBlocked)
        return;
    PasswordInputDialog dialog(this);
    dialog.validate();
    QPointer<Element> element(_element);
    if (dialog.exec() != QDialog::Accepted || !element)
        return;
    auto *data = new ElementData; // taken over by the task
    data->insert(QStringLiteral("password"), dialog.password());
    element->performOperation(Accounts::ChangePasswordOperation, data, 0);
}

GroupWidget::GroupWidget(AccountsModule &module, QWidget *parent)
    : ViewEditElementWidget(module, KvtAdmin::mayChangeSystem, parent)
{
    _elementType = Accounts::groupType;
    setObjectName(QStringLiteral("GroupWidget"));
    setWindowTitle(tr("Group"));
    auto *layout = new QVBoxLayout(this);
    auto *form = new QFormLayout;
    addField(form, _labels, QStringLiteral("name"), tr("Name:"), this);
    addField(form, _labels, QStringLiteral("gid"), tr("GID:"), this);
    addField(form, _labels, QStringLiteral("members"), tr("Members:"), this)->setWordWrap(true);
    layout->addLayout(form);
    layout->addStretch(1);
}

void GroupWidget::afterSuccessfulRead(Element *element, ElementData *data)
{
    if (element == _element && data) {
        _labels.value(QStringLiteral("name"))->setText(data->name());
        _labels.value(QStringLiteral("gid"))->setText(data->value(QStringLiteral("gid")).toString());
        _labels.value(QStringLiteral("members"))
            ->setText(data->value(QStringLiteral("members")).toStringList().join(QStringLiteral(", ")));
    }
    ViewEditElementWidget::afterSuccessfulRead(element, data);
}

void GroupWidget::blockEditWidget(bool block)
{
    ViewEditElementWidget::blockEditWidget(block);
    setEnabled(true);
}

QString GroupWidget::toolTipText() const
{
    return _element ? _element->toolTipText() : QString();
}

QString GroupWidget::fieldText(const QString &key) const
{
    QLabel *label = _labels.value(key);
    return label ? label->text() : QString();
}
