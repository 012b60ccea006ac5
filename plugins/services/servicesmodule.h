// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ADMIN_SERVICESMODULE_H
#define KVT_ADMIN_SERVICESMODULE_H

#include "servicebackend.h"

#include "../shared/toplevelgroup.h"

#include <kvt-common/containerelement.h>
#include <kvt-common/module.h>
#include <kvt-common/serviceelement.h>

#include <QList>
#include <QPointer>

class QAction;
class QTimer;

namespace Services {

//! Element types of the module.
const QString groupType = QStringLiteral("services");
const QString serviceType = QStringLiteral("service");

//! Operations of a service element, in the bits the library leaves to plugins.
enum ServiceOperation : quint64 {
    StartOperation = 0x1000,
    StopOperation = 0x2000,
    RestartOperation = 0x4000,
    ReloadOperation = 0x8000,
    ControlOperations = StartOperation | StopOperation | RestartOperation | ReloadOperation
};

} // namespace Services

/*!
 * The persistent "Services" node: its children, the host's services, are
 * read when it is first expanded, or right after the element tree is built.
 */
class ServicesGroupElement : public KvtAdmin::TopLevelGroup
{
    Q_OBJECT

public:
    explicit ServicesGroupElement(Module &module);
    QString toolTipText() const override;
};

/*!
 * One service of the host. Its record is the library's light service state
 * (the icon follows it); "name" holds the service name.
 */
class ServiceItemElement : public ServiceElement
{
    Q_OBJECT

public:
    ServiceItemElement(Module &module, const QString &name);
    QString serviceName() const { return title(); }
    /*! Whether the state is known and the service runs. */
    bool isRunning() const;
    bool isStateKnown() const;
    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;
    QString toolTipText() const override;
};

/*!
 * The services module: lists the host's services, reads their states on the
 * worker threads and starts, stops, restarts and reloads them.
 */
class ServicesModule : public Module
{
    Q_OBJECT

public:
    ServicesModule(const ServiceBackend &backend, QObject *parent);
    ~ServicesModule() override;

    void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                          int flags) override;

    const ServiceBackend &backend() const { return _backend; }
    ServicesGroupElement *group() const { return _group; }
    /*! The service the element actions act on: the one shown in the
     *  module's service widget. */
    ServiceItemElement *currentService() const { return _current; }
    void setCurrentService(ServiceItemElement *service);
    QAction *action(Services::ServiceOperation operation) const;

    /*! Replaces the services under the group (interface thread). */
    void setServices(const QStringList &names);
    /*! Called by a finished status read. */
    void statusReadFinished();
    /*! Status reads queued or running. */
    int pendingStatusReads() const { return _statusQueue.size() + _statusInFlight; }

public Q_SLOTS:
    /*! Enables the element actions for the current service's state and the
     *  rights. */
    void updateActions();

private Q_SLOTS:
    void triggerAction();
    void feedStatusReads();

private:
    void queueStatusRead(ServiceItemElement *service);
    void startControl(ServiceItemElement *service, quint64 operation);

    ServiceBackend _backend;
    ServicesGroupElement *_group;
    QPointer<ServiceItemElement> _current;
    QList<QAction *> _actions;
    QList<QPointer<ServiceItemElement>> _statusQueue;
    int _statusInFlight = 0;
    int _feedAttempts = 0;
    QTimer *_feedTimer;
};

#endif // KVT_ADMIN_SERVICESMODULE_H
