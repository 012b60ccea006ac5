// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "servicesmodule.h"

#include "../shared/admintools.h"
#include "servicewidget.h"

#include <kvt-common/elementdata.h>
#include <kvt-common/nodeselementwidget.h>
#include <kvt-common/readcontenttask.h>
#include <kvt-common/readpropertyheavytask.h>
#include <kvt-common/readpropertylightservicetask.h>
#include <kvt-common/reloadservicetask.h>
#include <kvt-common/restartservicetask.h>
#include <kvt-common/servicelightelementdata.h>
#include <kvt-common/startservicetask.h>
#include <kvt-common/stopservicetask.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/thread.h>

#include <QAction>
#include <QIcon>
#include <QLoggingCategory>
#include <QTimer>

Q_LOGGING_CATEGORY(KVT_ADMIN_SERVICES, "kvt.admin.services", QtWarningMsg)

namespace {

// Status reads share the workers' ring (64 slots) with every other task;
// this many at a time leaves room for the tasks the user starts.
const int maxStatusReadsInFlight = 24;
// A full ring is tried again after this pause, for at most a minute.
const int feedRetryMs = 100;
const int maxFeedAttempts = 600;

// Lists the services on a worker; the interface thread then merges them
// into the group.
class ListServicesTask : public ReadContentTask
{
public:
    ListServicesTask(ServicesGroupElement *group, ServicesModule *module)
        : ReadContentTask(group)
        , _backend(module->backend())
        , _module(module)
    {
        _taskDescription.setDescription(ServicesModule::tr("Read the list of services"));
    }

    void run() override
    {
        QString error;
        _services = _backend.listServices(&error);
        if (!error.isEmpty()) {
            _taskDescription.setStatus(TaskDescription::Fail);
            _taskDescription.setMessage(error);
        } else {
            _taskDescription.setStatus(TaskDescription::Success);
        }
        ReadContentTask::run();
    }

    void afterRun() override
    {
        if (!_module)
            return;
        if (_taskDescription.status() != TaskDescription::Fail)
            _module->setServices(_services);
        ReadContentTask::afterRun();
    }

private:
    ServiceBackend _backend;
    QPointer<ServicesModule> _module;
    QStringList _services;
};

void setUpServiceTask(ServiceTask *task, const ServicesModule *module, const ServiceItemElement *service)
{
    task->setProgram(module->backend().program());
    task->setCommandFirst(module->backend().commandFirst());
    task->setArguments(module->backend().serviceArguments(service->serviceName()));
}

// The light state read of the icons, started quietly (without the task
// dialog) for every listed service.
class StatusLightTask : public KvtAdmin::ElementGuarded<ReadPropertyLightServiceTask>
{
public:
    StatusLightTask(ServiceItemElement *service, ServicesModule *module)
        : ElementGuarded(service)
        , _module(module)
    {
        setUpServiceTask(this, module, service);
        _taskDescription.setDescription(ServicesModule::tr("Read the state of %1").arg(service->serviceName()));
    }

    void afterRun() override
    {
        if (_taskDescription.status() == TaskDescription::Fail)
            qCWarning(KVT_ADMIN_SERVICES, "%s", qPrintable(_taskDescription.message()));
        ElementGuarded::afterRun();
        if (_module)
            _module->statusReadFinished();
    }

private:
    QPointer<ServicesModule> _module;
};

// The full status of one service, for its widget: the program's own output
// and the state, which also goes to the element (and its icon).
class StatusHeavyTask : public ReadPropertyHeavyTask
{
public:
    StatusHeavyTask(ServiceItemElement *service, const ServicesModule *module)
        : ReadPropertyHeavyTask(service)
        , _guard(service)
        , _program(module->backend().program())
    {
        const ServiceBackend &backend = module->backend();
        _arguments = backend.serviceArguments(service->serviceName());
        if (backend.commandFirst())
            _arguments.prepend(QStringLiteral("status"));
        else
            _arguments.append(QStringLiteral("status"));
        _elementData = new ServiceLightElementData;
        _taskDescription.setDescription(ServicesModule::tr("Read the status of %1").arg(service->serviceName()));
    }

    void run() override
    {
        const KvtAdmin::ProgramResult result = KvtAdmin::runProgram(_program, _arguments);
        auto *record = static_cast<ServiceLightElementData *>(_elementData);
        if (!result.finished) {
            _taskDescription.setStatus(TaskDescription::Fail);
            _taskDescription.setMessage(result.message(_program));
        } else {
            // A stopped service answers with a non-zero code: a state, not a failure.
            record->setState(result.exitCode == 0);
            QString text = result.output;
            if (!result.error.isEmpty())
                text += (text.isEmpty() || text.endsWith(QLatin1Char('\n')) ? QString() : QStringLiteral("\n"))
                        + result.error;
            record->insert(QStringLiteral("statusText"), text);
            _taskDescription.setStatus(TaskDescription::Success);
        }
        ReadPropertyHeavyTask::run();
    }

    void afterRun() override
    {
        if (!_guard)
            return;
        if (_taskDescription.status() != TaskDescription::Fail) {
            auto *read = static_cast<ServiceLightElementData *>(_elementData);
            if (auto *state = dynamic_cast<ServiceLightElementData *>(_guard->elementData())) {
                state->setState(read->state());
                _guard->emitNodeDataChanged();
            }
        }
        ReadPropertyHeavyTask::afterRun();
    }

private:
    QPointer<ServiceItemElement> _guard;
    QString _program;
    QStringList _arguments;
};

template <class Base>
class ControlTask : public KvtAdmin::ElementGuarded<Base>
{
public:
    ControlTask(ServiceItemElement *service, const ServicesModule *module, const QString &description)
        : KvtAdmin::ElementGuarded<Base>(service)
        , _module(module)
    {
        setUpServiceTask(this, module, service);
        this->_taskDescription.setDescription(description);
    }

    void afterRun() override
    {
        KvtAdmin::ElementGuarded<Base>::afterRun();
        if (_module)
            const_cast<ServicesModule *>(_module.data())->updateActions();
    }

private:
    QPointer<const ServicesModule> _module;
};

} // namespace

ServicesGroupElement::ServicesGroupElement(Module &module)
    : KvtAdmin::TopLevelGroup(module, Services::groupType, ServicesModule::tr("Services"))
{
}

QString ServicesGroupElement::toolTipText() const
{
    return ServicesModule::tr("The services of this host");
}

ServiceItemElement::ServiceItemElement(Module &module, const QString &name)
    : ServiceElement(module, KvtAdmin::mayChangeSystem)
{
    _elementType = Services::serviceType;
    setTitle(name);
    _elementData->insert(QStringLiteral("name"), name);
}

bool ServiceItemElement::isStateKnown() const
{
    auto *state = dynamic_cast<ServiceLightElementData *>(_elementData);
    return state && !state->textState().isEmpty();
}

bool ServiceItemElement::isRunning() const
{
    auto *state = dynamic_cast<ServiceLightElementData *>(_elementData);
    return state && !state->textState().isEmpty() && state->state();
}

quint64 ServiceItemElement::availableOperations() const
{
    quint64 operations = ReadPropertyOperation;
    if (isEditable())
        operations |= Services::ControlOperations;
    return operations;
}

void ServiceItemElement::performOperation(OperationType type, ElementData *data, int flags)
{
    if (availableOperations() & quint64(type))
        _module.performOperation(this, type, data, flags);
}

QString ServiceItemElement::toolTipText() const
{
    auto *state = dynamic_cast<ServiceLightElementData *>(_elementData);
    if (!state || state->textState().isEmpty())
        return title();
    return QStringLiteral("%1: %2").arg(title(), state->textState());
}

ServicesModule::ServicesModule(const ServiceBackend &backend, QObject *parent)
    : Module(QStringLiteral("services"), parent, false)
    , _backend(backend)
    , _feedTimer(new QTimer(this))
{
    _expectedDepth = 1;
    QString description = tr("System services (%1)").arg(_backend.program());
    if (!KvtAdmin::changesAllowed())
        description += QLatin1Char(' ') + tr("- read-only: start kvt-admin with --allow-changes to control services");
    _moduleData->insert(QStringLiteral("description"), description);

    _group = new ServicesGroupElement(*this);
    _elementNodes << _group;

    struct ActionInfo {
        Services::ServiceOperation operation;
        QString text;
        const char *icon;
        const char *objectName;
    };
    const ActionInfo infos[] = {
        {Services::StartOperation, tr("Start"), "media-playback-start", "serviceStartAction"},
        {Services::StopOperation, tr("Stop"), "media-playback-stop", "serviceStopAction"},
        {Services::RestartOperation, tr("Restart"), "view-refresh", "serviceRestartAction"},
        {Services::ReloadOperation, tr("Reload"), "document-revert", "serviceReloadAction"},
    };
    for (const ActionInfo &info : infos) {
        auto *action = new QAction(QIcon::fromTheme(QLatin1String(info.icon)), info.text, this);
        action->setObjectName(QLatin1String(info.objectName));
        action->setData(quint64(info.operation));
        action->setEnabled(false);
        connect(action, SIGNAL(triggered()), this, SLOT(triggerAction()));
        _actions << action;
    }
    _elementActionsMap.insert(Services::serviceType, _actions);

    insertElementWidget(new NodesElementWidget(Services::groupType, *this, KvtAdmin::mayChangeSystem));
    insertElementWidget(new ServiceWidget(*this));
    connectElementWidgets();

    _feedTimer->setSingleShot(true);
    connect(_feedTimer, SIGNAL(timeout()), this, SLOT(feedStatusReads()));
}

ServicesModule::~ServicesModule()
{
    _feedTimer->stop();
    _statusQueue.clear();
    // Out of the element tree first, while the elements are whole: views
    // told of the removal may still ask them for their data.
    _group->clearDelete();
    for (TreeNode *node : qAsConst(_elementNodes))
        node->reset();
    qDeleteAll(_elementNodes);
    _elementNodes.clear();
}

QAction *ServicesModule::action(Services::ServiceOperation operation) const
{
    for (QAction *action : _actions) {
        if (action->data().toULongLong() == quint64(operation))
            return action;
    }
    return nullptr;
}

void ServicesModule::setCurrentService(ServiceItemElement *service)
{
    if (_current) {
        disconnect(_current, SIGNAL(nodeDataChanged(TreeNode*)), this, SLOT(updateActions()));
    }
    _current = service;
    if (_current)
        connect(_current, SIGNAL(nodeDataChanged(TreeNode*)), this, SLOT(updateActions()));
    updateActions();
}

void ServicesModule::updateActions()
{
    const bool editable = _current && _current->isEditable();
    const bool known = _current && _current->isStateKnown();
    const bool running = _current && _current->isRunning();
    action(Services::StartOperation)->setEnabled(editable && (!known || !running));
    action(Services::StopOperation)->setEnabled(editable && (!known || running));
    action(Services::RestartOperation)->setEnabled(editable);
    action(Services::ReloadOperation)->setEnabled(editable && (!known || running));
}

void ServicesModule::triggerAction()
{
    auto *action = qobject_cast<QAction *>(sender());
    if (!action || !_current)
        return;
    _current->performOperation(OperationType(action->data().toULongLong()), nullptr, 0);
}

void ServicesModule::performOperation(ContextOperation *context, OperationType type, ElementData *data,
                                      int flags)
{
    Module::performOperation(context, type, data, flags);
    Element *element = context ? context->elementContext() : nullptr;
    if (!element || &element->module() != this)
        return;
    auto *service = qobject_cast<ServiceItemElement *>(element);

    switch (quint64(type)) {
    case InsertedOperation:
        if (service)
            queueStatusRead(service);
        break;
    case ReadContentOperation:
        if (element == _group)
            TaskObserver::instance()->performTask(new ListServicesTask(_group, this));
        break;
    case ReadPropertyOperation:
        if (service)
            TaskObserver::instance()->performTask(new StatusHeavyTask(service, this));
        break;
    case Services::StartOperation:
    case Services::StopOperation:
    case Services::RestartOperation:
    case Services::ReloadOperation:
        // The offer is advisory; the rights are checked again here.
        if (service && service->isEditable())
            startControl(service, quint64(type));
        break;
    default:
        break;
    }
}

void ServicesModule::startControl(ServiceItemElement *service, quint64 operation)
{
    const QString name = service->serviceName();
    AbstractTask *task = nullptr;
    switch (operation) {
    case Services::StartOperation:
        task = new ControlTask<StartServiceTask>(service, this, tr("Start service %1").arg(name));
        break;
    case Services::StopOperation:
        task = new ControlTask<StopServiceTask>(service, this, tr("Stop service %1").arg(name));
        break;
    case Services::RestartOperation:
        task = new ControlTask<RestartServiceTask>(service, this, tr("Restart service %1").arg(name));
        break;
    case Services::ReloadOperation:
        task = new ControlTask<ReloadServiceTask>(service, this, tr("Reload service %1").arg(name));
        break;
    default:
        return;
    }
    TaskObserver::instance()->performTask(task);
}

void ServicesModule::setServices(const QStringList &names)
{
    // Merged rather than rebuilt: elements that stay keep their state and
    // any widget showing them.
    QSet<QString> wanted(names.begin(), names.end());
    const QList<TreeNode *> children = _group->childNodes();
    QSet<QString> present;
    for (TreeNode *node : children) {
        auto *service = qobject_cast<ServiceItemElement *>(node);
        if (service && wanted.contains(service->serviceName())) {
            present.insert(service->serviceName());
            queueStatusRead(service);
        } else {
            _group->removeOne(node);
            delete node;
        }
    }
    for (const QString &name : names) {
        if (present.contains(name))
            continue;
        int position = 0;
        const QList<TreeNode *> &current = _group->childNodes();
        while (position < current.size()
               && static_cast<Element *>(current.at(position))->title() < name)
            ++position;
        _group->insert(position, new ServiceItemElement(*this, name));
    }
}

void ServicesModule::queueStatusRead(ServiceItemElement *service)
{
    _statusQueue.append(service);
    if (!_feedTimer->isActive())
        _feedTimer->start(0);
}

void ServicesModule::statusReadFinished()
{
    if (_statusInFlight > 0)
        --_statusInFlight;
    if (!_statusQueue.isEmpty() && !_feedTimer->isActive())
        _feedTimer->start(0);
}

void ServicesModule::feedStatusReads()
{
    while (_statusInFlight < maxStatusReadsInFlight && !_statusQueue.isEmpty()) {
        ServiceItemElement *service = _statusQueue.first();
        if (!service) {
            _statusQueue.removeFirst();
            continue;
        }
        auto *task = new StatusLightTask(service, this);
        // Straight into the workers' ring: a state read for every service
        // would otherwise fill the task dialog and block the window.
        if (!Thread::put(task)) {
            delete task;
            if (++_feedAttempts > maxFeedAttempts) {
                qCWarning(KVT_ADMIN_SERVICES, "No worker takes the service state reads; %d dropped",
                          _statusQueue.size());
                _statusQueue.clear();
                _feedAttempts = 0;
                return;
            }
            _feedTimer->start(feedRetryMs);
            return;
        }
        _feedAttempts = 0;
        _statusQueue.removeFirst();
        ++_statusInFlight;
    }
}
