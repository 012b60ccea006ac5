// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "postgresqlmodule.h"

#include "../shared/admintools.h"
#include "postgresqlwidgets.h"

#include <kvt-common/appexception.h>
#include <kvt-common/createtask.h>
#include <kvt-common/deletetask.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/passworddialog.h>
#include <kvt-common/pgsqlcluster.h>
#include <kvt-common/pgsqlmanagerasync.h>
#include <kvt-common/readcontenttask.h>
#include <kvt-common/taskobserver.h>

#include <QAction>
#include <QApplication>
#include <QIcon>
#include <QMessageBox>

#include <memory>

namespace {

const QString nameKey = QStringLiteral("name");
const QString passwordKey = QStringLiteral("password");

// A cluster object of the task's own: the manager's objects are replaced at
// every read, while a task may still be queued.
std::unique_ptr<PgsqlCluster> clusterFor(const QString &line)
{
    return std::unique_ptr<PgsqlCluster>(PgsqlCluster::fromString(line));
}

void fail(TaskDescription &description, const QString &message)
{
    description.setStatus(TaskDescription::Fail);
    description.setMessage(message);
}

class ReadUsersTask : public KvtAdmin::ElementGuarded<ReadContentTask>
{
public:
    ReadUsersTask(ClusterElement *cluster, PostgresqlModule *module)
        : ElementGuarded(cluster)
        , _line(cluster->info().line())
        , _module(module)
    {
        _taskDescription.setDescription(PostgresqlModule::tr("Read the users of cluster %1").arg(cluster->title()));
    }

    void run() override
    {
        try {
            _users = clusterFor(_line)->usernames();
            _taskDescription.setStatus(TaskDescription::Success);
        } catch (const AppException &e) {
            fail(_taskDescription, e.getText());
        }
        ReadContentTask::run();
    }

    void afterRun() override
    {
        if (elementAlive() && _module && _taskDescription.status() != TaskDescription::Fail)
            _module->setUsers(static_cast<ClusterElement *>(_element), _users);
        ElementGuarded::afterRun();
    }

private:
    QString _line;
    QPointer<PostgresqlModule> _module;
    QStringList _users;
};

class CreateUserTask : public KvtAdmin::ElementGuarded<CreateTask>
{
public:
    CreateUserTask(ClusterElement *cluster, ElementData *data, PostgresqlModule *module)
        : ElementGuarded(cluster, data)
        , _info(cluster->info())
        , _module(module)
    {
        _taskDescription.setDescription(PostgresqlModule::tr("Create database user %1 in cluster %2")
                                            .arg(data->name(), cluster->title()));
    }

    void run() override
    {
        const QString name = _elementData->name();
        const QString password = _elementData->value(passwordKey).toString();
        try {
            // The library refuses a name that is not a plain identifier
            // before any shell sees it.
            clusterFor(_info.line())->createUser(name);
            if (!password.isEmpty())
                setPassword(name, password);
            else
                _taskDescription.setStatus(TaskDescription::Success);
        } catch (const AppException &e) {
            fail(_taskDescription, e.getText());
        }
        // The password is not kept once it has been used.
        _elementData->remove(passwordKey);
        CreateTask::run();
    }

    void afterRun() override
    {
        const bool paranoid = _module && _module->getData(QStringLiteral("paranoid")).toBool();
        ElementGuarded::afterRun();
        // In force reread mode the library reads the cluster again; otherwise
        // the new user is trusted and listed at once.
        if (!paranoid && elementAlive() && _module && _taskDescription.status() != TaskDescription::Fail) {
            auto *cluster = static_cast<ClusterElement *>(_element);
            QStringList names;
            for (TreeNode *node : cluster->childNodes())
                names << static_cast<Element *>(node)->title();
            if (!cluster->requireLoad()) {
                names << _elementData->name();
                _module->setUsers(cluster, names);
            }
        }
    }

private:
    // The password goes to psql on its standard input, never on a command
    // line where other users of the host could read it.
    void setPassword(const QString &name, const QString &password)
    {
        QString literal = password;
        literal.replace(QLatin1Char('\''), QLatin1String("''"));
        const QString sql = QStringLiteral("ALTER ROLE %1 PASSWORD '%2';\n").arg(name, literal);
        const KvtAdmin::ProgramResult result = KvtAdmin::runProgram(
            QStringLiteral("runuser"),
            {QStringLiteral("-u"), QStringLiteral("postgres"), QStringLiteral("--"), QStringLiteral("psql"),
             QStringLiteral("-X"), QStringLiteral("-q"), QStringLiteral("-v"), QStringLiteral("ON_ERROR_STOP=1"),
             QStringLiteral("-p"), QString::number(_info.port), QStringLiteral("-f"), QStringLiteral("-")},
            sql.toUtf8());
        if (result.ok())
            _taskDescription.setStatus(TaskDescription::Success);
        else
            fail(_taskDescription, PostgresqlModule::tr("User %1 created, but its password was not set: %2")
                                       .arg(name, result.message(QStringLiteral("psql"))));
    }

    Pgsql::ClusterInfo _info;
    QPointer<PostgresqlModule> _module;
};

class DropUserTask : public KvtAdmin::ElementGuarded<DeleteTask>
{
public:
    explicit DropUserTask(PgUserElement *user)
        : ElementGuarded(user)
        , _name(user->title())
        , _line(user->cluster() ? user->cluster()->info().line() : QString())
    {
        _taskDescription.setDescription(PostgresqlModule::tr("Drop database user %1").arg(_name));
    }

    void run() override
    {
        try {
            clusterFor(_line)->deleteUser(_name);
            _taskDescription.setStatus(TaskDescription::Success);
        } catch (const AppException &e) {
            fail(_taskDescription, e.getText());
        }
        DeleteTask::run();
    }

private:
    QString _name;
    QString _line;
};

class StartClusterTask : public ElementTask
{
public:
    StartClusterTask(ClusterElement *cluster, PostgresqlModule *module)
        : ElementTask(cluster)
        , _guard(cluster)
        , _line(cluster->info().line())
        , _module(module)
    {
        _taskDescription.setDescription(PostgresqlModule::tr("Start cluster %1").arg(cluster->title()));
    }

    void run() override
    {
        try {
            clusterFor(_line)->start();
            _taskDescription.setStatus(TaskDescription::Success);
        } catch (const AppException &e) {
            fail(_taskDescription, e.getText());
        }
        ElementTask::run();
    }

    void afterRun() override
    {
        if (_guard && _taskDescription.status() != TaskDescription::Fail)
            _guard->resetRequireLoad();
        // The list tells the new state, whatever the outcome.
        if (_module)
            _module->readClusters();
    }

private:
    QPointer<ClusterElement> _guard;
    QString _line;
    QPointer<PostgresqlModule> _module;
};

} // namespace

Pgsql::ClusterInfo Pgsql::ClusterInfo::from(const PgsqlCluster &cluster)
{
    ClusterInfo info;
    info.version = cluster.version();
    info.name = cluster.name();
    info.port = cluster.port();
    info.status = cluster.status();
    info.owner = cluster.owner();
    info.dataDirectory = cluster.dataDirectory();
    info.logFile = cluster.logFile();
    return info;
}

QString Pgsql::ClusterInfo::line() const
{
    return QStringList{version, name, QString::number(port), status, owner, dataDirectory, logFile}.join(
        QLatin1Char(' '));
}

ClustersGroupElement::ClustersGroupElement(Module &module)
    : KvtAdmin::TopLevelGroup(module, Pgsql::groupType, PostgresqlModule::tr("PostgreSQL clusters"))
{
}

QString ClustersGroupElement::toolTipText() const
{
    return PostgresqlModule::tr("The PostgreSQL clusters of this host");
}

ClusterElement::ClusterElement(Module &module, const Pgsql::ClusterInfo &info)
    : ContainerElement(module, KvtAdmin::mayChangeSystem)
    , _info(info)
{
    _elementType = Pgsql::clusterType;
    setTitle(info.title());
    _elementData = new ElementData;
    setInfo(info);
}

void ClusterElement::setInfo(const Pgsql::ClusterInfo &info)
{
    _info = info;
    _elementData->insert(QStringLiteral("version"), info.version);
    _elementData->insert(QStringLiteral("name"), info.name);
    _elementData->insert(QStringLiteral("port"), info.port);
    _elementData->insert(QStringLiteral("status"), info.status);
    _elementData->insert(QStringLiteral("owner"), info.owner);
    _elementData->insert(QStringLiteral("dataDirectory"), info.dataDirectory);
    _elementData->insert(QStringLiteral("logFile"), info.logFile);
    emitNodeDataChanged();
}

ElementWidget *ClusterElement::elementWidget(ElementWidgetRole role)
{
    auto &module = static_cast<PostgresqlModule &>(_module);
    if (role != CreateElementRole)
        return ContainerElement::elementWidget(role);
    module.setCreateTarget(this);
    return module.elementWidget(Pgsql::newUserType);
}

quint64 ClusterElement::availableOperations() const
{
    // Users can be read and created only while the cluster runs.
    if (!_info.isOnline())
        return isEditable() ? Pgsql::StartClusterOperation : 0;
    return ReadContentOperation | (isEditable() ? CreateOperation : 0);
}

void ClusterElement::performOperation(OperationType type, ElementData *data, int flags)
{
    if (quint64(type) == Pgsql::StartClusterOperation)
        _module.performOperation(this, type, data, flags);
    else
        ContainerElement::performOperation(type, data, flags);
}

QString ClusterElement::toolTipText() const
{
    return PostgresqlModule::tr("Cluster %1, port %2, %3").arg(title()).arg(_info.port).arg(_info.status);
}

PgUserElement::PgUserElement(Module &module, const QString &name)
    : OrdinaryElement(module, KvtAdmin::mayChangeSystem)
{
    _elementType = Pgsql::userType;
    setTitle(name);
    _elementData = new ElementData;
    _elementData->setName(name);
}

ClusterElement *PgUserElement::cluster() const
{
    return qobject_cast<ClusterElement *>(parentNode());
}

quint64 PgUserElement::availableOperations() const
{
    return isEditable() && cluster() ? quint64(DeleteOperation) : 0;
}

void PgUserElement::performOperation(OperationType type, ElementData *data, int flags)
{
    if (type == DeleteOperation)
        OrdinaryElement::performOperation(type, data, flags);
}

QString PgUserElement::questionForRemove() const
{
    return PostgresqlModule::tr("Do you really want to drop the database user %1?").arg(title());
}

QString PgUserElement::toolTipText() const
{
    return PostgresqlModule::tr("Database user %1").arg(title());
}

PostgresqlModule::PostgresqlModule(QObject *parent)
    : Module(QStringLiteral("postgresql"), parent, false)
    , _manager(new PgsqlManagerAsync(this))
{
    _expectedDepth = 1;
    QString description = tr("PostgreSQL clusters and their users");
    if (!KvtAdmin::changesAllowed())
        description += QLatin1Char(' ') + tr("- read-only: start kvt-admin with --allow-changes to change them");
    _moduleData->insert(QStringLiteral("description"), description);

    _group = new ClustersGroupElement(*this);
    _elementNodes << _group;

    connect(_manager, SIGNAL(clustersReaded(QList<PgsqlCluster*>)), this,
            SLOT(clustersReaded(QList<PgsqlCluster*>)));
    connect(_manager, SIGNAL(exceptionArise(AppException)), this, SLOT(exceptionArise(AppException)));

    _startAction = new QAction(QIcon::fromTheme(QStringLiteral("media-playback-start")), tr("Start cluster"), this);
    _startAction->setObjectName(QStringLiteral("pgsqlStartClusterAction"));
    connect(_startAction, SIGNAL(triggered()), this, SLOT(startCurrentCluster()));
    _elementActionsMap.insert(Pgsql::clusterType, {_startAction});

    insertElementWidget(new ClusterWidget(*this));
    insertElementWidget(new PgUserWidget(*this));
    insertElementWidget(new PgUserCreateWidget(*this));
    connectElementWidgets();
}

PostgresqlModule::~PostgresqlModule()
{
    // A running read still reports to this module: wait for it first.
    delete _manager;
    _manager = nullptr;
    const QList<TreeNode *> clusters = _group->childNodes();
    for (TreeNode *cluster : clusters)
        cluster->clearDelete();
    _group->clearDelete();
    for (TreeNode *node : qAsConst(_elementNodes))
        node->reset();
    qDeleteAll(_elementNodes);
    _elementNodes.clear();
}

ClusterElement *PostgresqlModule::cluster(const QString &title) const
{
    for (TreeNode *node : _group->childNodes()) {
        auto *cluster = qobject_cast<ClusterElement *>(node);
        if (cluster && cluster->title() == title)
            return cluster;
    }
    return nullptr;
}

void PostgresqlModule::readClusters()
{
    if (!_manager || _reading)
        return;
    _reading = true;
    _pendingError.clear();
    _manager->startReadClusters();
}

void PostgresqlModule::exceptionArise(const AppException &exception)
{
    _pendingError = exception.getText();
}

void PostgresqlModule::clustersReaded(const QList<PgsqlCluster *> &clusters)
{
    _reading = false;
    _lastError = _pendingError;
    if (!_lastError.isEmpty())
        QMessageBox::warning(qobject_cast<QWidget *>(QApplication::activeWindow()), tr("PostgreSQL clusters"),
                             tr("The clusters could not be read:\n%1").arg(_lastError));

    // Merged rather than rebuilt: a cluster that stays keeps its users and
    // any widget showing it. The library's objects are copied at once: they
    // are deleted at the next read.
    QMap<QString, Pgsql::ClusterInfo> read;
    for (const PgsqlCluster *cluster : clusters) {
        const Pgsql::ClusterInfo info = Pgsql::ClusterInfo::from(*cluster);
        read.insert(info.title(), info);
    }
    const QList<TreeNode *> children = _group->childNodes();
    for (TreeNode *node : children) {
        auto *cluster = static_cast<ClusterElement *>(node);
        auto found = read.find(cluster->title());
        if (found == read.end()) {
            _group->removeOne(cluster);
            cluster->clearDelete();
            delete cluster;
            continue;
        }
        const bool wasOnline = cluster->info().isOnline();
        cluster->setInfo(found.value());
        if (wasOnline != found->isOnline()) {
            cluster->clearDelete();
            cluster->resetRequireLoad();
        }
        read.erase(found);
    }
    for (const Pgsql::ClusterInfo &info : qAsConst(read)) {
        int position = 0;
        while (position < _group->childNodesCount()
               && static_cast<Element *>(_group->childNodes().at(position))->title() < info.title())
            ++position;
        _group->insert(position, new ClusterElement(*this, info));
    }
    if (auto *shown = currentCluster())
        _startAction->setEnabled(shown->availableOperations() & Pgsql::StartClusterOperation);
    Q_EMIT clustersRead();
}

void PostgresqlModule::setUsers(ClusterElement *cluster, const QStringList &names)
{
    QSet<QString> wanted(names.begin(), names.end());
    QSet<QString> present;
    const QList<TreeNode *> children = cluster->childNodes();
    for (TreeNode *node : children) {
        auto *user = static_cast<PgUserElement *>(node);
        if (wanted.contains(user->title()) && !present.contains(user->title())) {
            present.insert(user->title());
        } else {
            cluster->removeOne(user);
            delete user;
        }
    }
    QStringList sorted = names;
    sorted.sort();
    for (const QString &name : qAsConst(sorted)) {
        if (present.contains(name))
            continue;
        present.insert(name);
        int position = 0;
        while (position < cluster->childNodesCount()
               && static_cast<Element *>(cluster->childNodes().at(position))->title() < name)
            ++position;
        cluster->insert(position, new PgUserElement(*this, name));
    }
}

ClusterElement *PostgresqlModule::currentCluster() const
{
    if (auto *cluster = qobject_cast<ClusterElement *>(_current.data()))
        return cluster;
    if (auto *user = qobject_cast<PgUserElement *>(_current.data()))
        return user->cluster();
    return nullptr;
}

void PostgresqlModule::performOperation(ContextOperation *context, OperationType type, ElementData *data,
                                        int flags)
{
    Module::performOperation(context, type, data, flags);
    if (!context || &context->module() != this)
        return;
    if (context->elementWidgetContext()) {
        // The creation widget applies: a new user in the cluster it was
        // shown for. The exported record is taken over.
        if (type == CreateOperation && _createTarget && _createTarget->isEditable())
            createUser(_createTarget, data);
        else
            delete data;
        return;
    }
    Element *element = context->elementContext();
    if (!element)
        return;

    if (element == _group) {
        if (type == ReadContentOperation)
            readClusters();
        return;
    }
    if (auto *cluster = qobject_cast<ClusterElement *>(element)) {
        switch (quint64(type)) {
        case ReadContentOperation:
            if (cluster->info().isOnline())
                TaskObserver::instance()->performTask(new ReadUsersTask(cluster, this));
            break;
        case CreateOperation:
            if (cluster->isEditable())
                createUser(cluster, data);
            break;
        case Pgsql::StartClusterOperation:
            if (cluster->isEditable())
                TaskObserver::instance()->performTask(new StartClusterTask(cluster, this));
            break;
        default:
            break;
        }
        return;
    }
    auto *user = qobject_cast<PgUserElement *>(element);
    if (user && type == DeleteOperation && user->isEditable() && user->cluster())
        TaskObserver::instance()->performTask(new DropUserTask(user));
}

void PostgresqlModule::createUser(ClusterElement *cluster, ElementData *data)
{
    // A record given is the caller's new one, taken over here.
    std::unique_ptr<ElementData> given(data);
    QString name = data ? data->name() : QString();
    QString password = data ? data->value(passwordKey).toString() : QString();
    if (name.isEmpty()) {
        // Name and password come from the library's credential dialog.
        PasswordDialog dialog(qobject_cast<QWidget *>(QApplication::activeWindow()));
        dialog.setWindowTitle(tr("New user of cluster %1").arg(cluster->title()));
        dialog.checkValid();
        if (dialog.exec() != QDialog::Accepted)
            return;
        name = dialog.user();
        password = dialog.password();
    }
    QPointer<ClusterElement> guard(cluster);
    if (!guard)
        return;
    auto *record = new ElementData;
    record->setName(name);
    record->insert(passwordKey, password);
    TaskObserver::instance()->performTask(new CreateUserTask(cluster, record, this));
}

void PostgresqlModule::startCurrentCluster()
{
    if (ClusterElement *cluster = currentCluster())
        cluster->performOperation(OperationType(Pgsql::StartClusterOperation), nullptr, 0);
}
