// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "postgresqlwidgets.h"

#include "../shared/admintools.h"
#include "postgresqlmodule.h"

#include <kvt-common/elementdata.h>

#include <kvt-common/passworddialog.h>

#include <QAction>
#include <QPushButton>
#include <QTimer>
#include <QFormLayout>
#include <QHBoxLayout>
#include <QLabel>
#include <QToolButton>
#include <QVBoxLayout>

PgsqlInfoWidget::PgsqlInfoWidget(PostgresqlModule &module, const QString &type,
                                 const QList<QPair<QString, QString>> &fields, QWidget *parent)
    : ViewEditElementWidget(module, KvtAdmin::mayChangeSystem, parent)
    , _pgsqlModule(module)
{
    _elementType = type;
    auto *layout = new QVBoxLayout(this);
    auto *form = new QFormLayout;
    for (const auto &field : fields) {
        auto *label = new QLabel(this);
        label->setObjectName(QLatin1Char('_') + field.first + QStringLiteral("Label"));
        label->setTextInteractionFlags(Qt::TextSelectableByMouse);
        form->addRow(field.second, label);
        _fields << qMakePair(field.first, label);
    }
    layout->addLayout(form);
    auto *buttons = new QHBoxLayout;
    for (QAction *action : module.elementActions(type)) {
        auto *button = new QToolButton(this);
        button->setDefaultAction(action);
        button->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
        button->setObjectName(QLatin1Char('_') + action->objectName() + QStringLiteral("ToolButton"));
        buttons->addWidget(button);
    }
    buttons->addStretch(1);
    layout->addLayout(buttons);
    layout->addStretch(1);
}

void PgsqlInfoWidget::setElement(Element *element, ElementWidgetRole role)
{
    Element *previous = _element;
    if (previous)
        disconnect(previous, SIGNAL(nodeDataChanged(TreeNode*)), this, SLOT(refresh()));
    ViewEditElementWidget::setElement(element, role);
    if (_element) {
        connect(_element, SIGNAL(nodeDataChanged(TreeNode*)), this, SLOT(refresh()), Qt::UniqueConnection);
        _pgsqlModule._current = _element;
    } else if (previous && _pgsqlModule._current == previous) {
        // The actions act on the element shown; none is shown any more.
        _pgsqlModule._current = nullptr;
    }
    refresh();
}

void PgsqlInfoWidget::read()
{
    if (_element && _role == EditElementRole)
        afterSuccessfulRead(_element, _element->elementData());
}

void PgsqlInfoWidget::afterSuccessfulRead(Element *element, ElementData *data)
{
    refresh();
    ViewEditElementWidget::afterSuccessfulRead(element, data);
}

void PgsqlInfoWidget::blockEditWidget(bool block)
{
    ViewEditElementWidget::blockEditWidget(block);
    // Nothing is edited in place; the buttons follow the actions.
    setEnabled(true);
}

QString PgsqlInfoWidget::toolTipText() const
{
    return _element ? _element->toolTipText() : QString();
}

QString PgsqlInfoWidget::fieldText(const QString &key) const
{
    for (const auto &field : _fields) {
        if (field.first == key)
            return field.second->text();
    }
    return QString();
}

void PgsqlInfoWidget::refresh()
{
    const ElementData *data = _element ? _element->elementData() : nullptr;
    for (const auto &field : qAsConst(_fields))
        field.second->setText(data ? data->value(field.first).toString() : QString());
    const quint64 operations = _element ? _element->availableOperations() : 0;
    for (QAction *action : _pgsqlModule.elementActions(_elementType)) {
        if (action->objectName() == QLatin1String("pgsqlStartClusterAction"))
            action->setEnabled(operations & Pgsql::StartClusterOperation);
        else if (action->objectName() == QLatin1String("pgsqlCreateUserAction"))
            action->setEnabled(operations & CreateOperation);
        else
            action->setEnabled(operations & DeleteOperation);
    }
}

ClusterWidget::ClusterWidget(PostgresqlModule &module, QWidget *parent)
    : PgsqlInfoWidget(module, Pgsql::clusterType,
                      {{QStringLiteral("version"), tr("Version:")},
                       {QStringLiteral("name"), tr("Name:")},
                       {QStringLiteral("port"), tr("Port:")},
                       {QStringLiteral("status"), tr("Status:")},
                       {QStringLiteral("owner"), tr("Owner:")},
                       {QStringLiteral("dataDirectory"), tr("Data directory:")},
                       {QStringLiteral("logFile"), tr("Log file:")}},
                      parent)
{
    setObjectName(QStringLiteral("ClusterWidget"));
    setWindowTitle(tr("Cluster"));
}

PgUserWidget::PgUserWidget(PostgresqlModule &module, QWidget *parent)
    : PgsqlInfoWidget(module, Pgsql::userType, {{QStringLiteral("name"), tr("User:")}}, parent)
{
    setObjectName(QStringLiteral("PgUserWidget"));
    setWindowTitle(tr("Database user"));
}

PgUserCreateWidget::PgUserCreateWidget(PostgresqlModule &module, QWidget *parent)
    : ViewEditElementWidget(module, KvtAdmin::mayChangeSystem, parent)
    , _pgsqlModule(module)
{
    _elementType = Pgsql::newUserType;
    setObjectName(QStringLiteral("PgUserCreateWidget"));
    setWindowTitle(tr("New database user"));
    auto *layout = new QVBoxLayout(this);
    auto *form = new QFormLayout;
    _clusterLabel = new QLabel(this);
    _clusterLabel->setObjectName(QStringLiteral("_clusterLabel"));
    _userLabel = new QLabel(this);
    _userLabel->setObjectName(QStringLiteral("_userLabel"));
    form->addRow(tr("Cluster:"), _clusterLabel);
    form->addRow(tr("User:"), _userLabel);
    layout->addLayout(form);
    auto *button = new QPushButton(tr("Name and password..."), this);
    button->setObjectName(QStringLiteral("_credentialsPushButton"));
    connect(button, SIGNAL(clicked()), this, SLOT(askCredentials()));
    auto *buttons = new QHBoxLayout;
    buttons->addWidget(button);
    buttons->addStretch(1);
    layout->addLayout(buttons);
    layout->addStretch(1);
}

void PgUserCreateWidget::beforeCreation()
{
    _user.clear();
    _password.clear();
    _userLabel->clear();
    _clusterLabel->setText(_pgsqlModule._createTarget ? _pgsqlModule._createTarget->title() : QString());
    // After the widget is on display, not inside the container's switch.
    QTimer::singleShot(0, this, SLOT(askCredentials()));
}

void PgUserCreateWidget::askCredentials()
{
    if (_role != CreateElementRole || !isVisible())
        return;
    PasswordDialog dialog(this);
    dialog.setWindowTitle(tr("New user of cluster %1").arg(_clusterLabel->text()));
    dialog.setUser(_user);
    dialog.checkValid();
    if (dialog.exec() != QDialog::Accepted)
        return;
    _user = dialog.user();
    _password = dialog.password();
    _userLabel->setText(_user);
    changeContent();
}

ElementData *PgUserCreateWidget::exportElementData() const
{
    auto *data = new ElementData;
    data->setName(_user);
    data->insert(QStringLiteral("password"), _password);
    return data;
}

bool PgUserCreateWidget::isContentValid() const
{
    // The name itself is checked by the library when the user is created,
    // and its refusal reaches the task list.
    return !_user.isEmpty();
}

QString PgUserCreateWidget::toolTipText() const
{
    return windowTitle();
}

QString PgUserCreateWidget::caption() const
{
    return tr("New user of cluster %1").arg(_clusterLabel->text());
}
