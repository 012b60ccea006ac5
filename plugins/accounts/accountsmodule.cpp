// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "accountsmodule.h"

#include "../shared/admintools.h"
#include "accountswidgets.h"

#include <kvt-common/elementdata.h>
#include <kvt-common/nodeselementwidget.h>
#include <kvt-common/readcontenttask.h>
#include <kvt-common/readpropertyheavytask.h>
#include <kvt-common/taskobserver.h>

#include <QFile>
#include <QRegularExpression>
#include <QSet>

#include <functional>

namespace {

const QString gecosKey = QStringLiteral("gecos");
const QString passwordKey = QStringLiteral("password");
const QString addGroupsKey = QStringLiteral("addGroups");
const QString removeGroupsKey = QStringLiteral("removeGroups");

void fail(TaskDescription &description, const QString &message)
{
    description.setStatus(TaskDescription::Fail);
    description.setMessage(message);
}

QStringList lines(const QString &text)
{
    return text.split(QLatin1Char('\n'), Qt::SkipEmptyParts);
}

// Reads the users or the groups on a worker.
class ReadAccountsTask : public KvtAdmin::ElementGuarded<ReadContentTask>
{
public:
    ReadAccountsTask(AccountsGroupElement *group, AccountsModule *module, bool users)
        : ElementGuarded(group)
        , _module(module)
        , _readUsers(users)
    {
        _taskDescription.setDescription(users ? AccountsModule::tr("Read the users")
                                              : AccountsModule::tr("Read the groups"));
    }

    void run() override
    {
        const QString database = _readUsers ? QStringLiteral("passwd") : QStringLiteral("group");
        const KvtAdmin::ProgramResult result = KvtAdmin::runProgram(QStringLiteral("getent"), {database});
        if (!result.ok()) {
            fail(_taskDescription, result.message(QStringLiteral("getent")));
        } else {
            const uint uidMin = Accounts::firstHumanUid();
            for (const QString &line : lines(result.output)) {
                Accounts::PasswdEntry user;
                Accounts::GroupEntry group;
                if (_readUsers && Accounts::PasswdEntry::parse(line, &user) && user.isListed(uidMin))
                    _users << user;
                else if (!_readUsers && Accounts::GroupEntry::parse(line, &group))
                    _groups << group;
            }
            _taskDescription.setStatus(TaskDescription::Success);
        }
        ReadContentTask::run();
    }

    void afterRun() override
    {
        if (elementAlive() && _module && _taskDescription.status() != TaskDescription::Fail) {
            if (_readUsers)
                _module->setUsers(_users);
            else
                _module->setGroups(_groups);
        }
        ElementGuarded::afterRun();
    }

private:
    QPointer<AccountsModule> _module;
    bool _readUsers;
    QList<Accounts::PasswdEntry> _users;
    QList<Accounts::GroupEntry> _groups;
};

// Reads one user with its groups, for the user's widget.
class ReadUserTask : public KvtAdmin::ElementGuarded<ReadPropertyHeavyTask>
{
public:
    explicit ReadUserTask(UserElement *user)
        : ElementGuarded(user)
        , _login(user->login())
    {
        _elementData = new ElementData;
        _taskDescription.setDescription(AccountsModule::tr("Read user %1").arg(_login));
    }

    void run() override
    {
        read();
        ReadPropertyHeavyTask::run();
    }

    void afterRun() override
    {
        if (elementAlive() && _taskDescription.status() != TaskDescription::Fail)
            static_cast<UserElement *>(_element)->setEntry(_entry);
        ElementGuarded::afterRun();
    }

private:
    void read()
    {
        if (!KvtAdmin::isSafeName(_login))
            return fail(_taskDescription, AccountsModule::tr("'%1' is not a valid user name").arg(_login));
        const KvtAdmin::ProgramResult passwd
            = KvtAdmin::runProgram(QStringLiteral("getent"), {QStringLiteral("passwd"), _login});
        if (!passwd.ok() || !Accounts::PasswdEntry::parse(passwd.output.trimmed(), &_entry))
            return fail(_taskDescription, AccountsModule::tr("User %1 not found").arg(_login));
        const KvtAdmin::ProgramResult primary
            = KvtAdmin::runProgram(QStringLiteral("id"), {QStringLiteral("-gn"), _login});
        const KvtAdmin::ProgramResult groups
            = KvtAdmin::runProgram(QStringLiteral("id"), {QStringLiteral("-Gn"), _login});
        if (!primary.ok())
            return fail(_taskDescription, primary.message(QStringLiteral("id")));
        if (!groups.ok())
            return fail(_taskDescription, groups.message(QStringLiteral("id")));
        _elementData->insert(QStringLiteral("user"), _entry.login);
        _elementData->insert(QStringLiteral("uid"), _entry.uid);
        _elementData->insert(QStringLiteral("gid"), _entry.gid);
        _elementData->insert(gecosKey, _entry.gecos);
        _elementData->insert(QStringLiteral("home"), _entry.home);
        _elementData->insert(QStringLiteral("shell"), _entry.shell);
        _elementData->insert(QStringLiteral("primaryGroup"), primary.output.trimmed());
        _elementData->insert(QStringLiteral("groups"),
                             groups.output.simplified().split(QLatin1Char(' '), Qt::SkipEmptyParts));
        _taskDescription.setStatus(TaskDescription::Success);
    }

    QString _login;
    Accounts::PasswdEntry _entry;
};

class ReadGroupTask : public KvtAdmin::ElementGuarded<ReadPropertyHeavyTask>
{
public:
    explicit ReadGroupTask(GroupElement *group)
        : ElementGuarded(group)
        , _name(group->title())
    {
        _elementData = new ElementData;
        _taskDescription.setDescription(AccountsModule::tr("Read group %1").arg(_name));
    }

    void run() override
    {
        const KvtAdmin::ProgramResult result
            = KvtAdmin::runProgram(QStringLiteral("getent"), {QStringLiteral("group"), _name});
        if (!KvtAdmin::isSafeName(_name) || !result.ok()
            || !Accounts::GroupEntry::parse(result.output.trimmed(), &_entry)) {
            fail(_taskDescription, AccountsModule::tr("Group %1 not found").arg(_name));
        } else {
            _elementData->setName(_entry.name);
            _elementData->insert(QStringLiteral("gid"), _entry.gid);
            _elementData->insert(QStringLiteral("members"), _entry.members);
            _taskDescription.setStatus(TaskDescription::Success);
        }
        ReadPropertyHeavyTask::run();
    }

    void afterRun() override
    {
        if (elementAlive() && _taskDescription.status() != TaskDescription::Fail)
            static_cast<GroupElement *>(_element)->setEntry(_entry);
        ElementGuarded::afterRun();
    }

private:
    QString _name;
    Accounts::GroupEntry _entry;
};

// One program run of a change: no shell, arguments checked beforehand.
struct Command
{
    QString program;
    QStringList arguments;
    QByteArray input;
};

/*!
 * Runs the commands of one change of a user in order, stopping at the first
 * failure with the program's own message; afterwards the user (and, after a
 * change of groups, the groups) are read again so the window shows what the
 * system now holds.
 */
class ChangeUserTask : public ElementTask
{
public:
    ChangeUserTask(UserElement *user, ElementData *data, AccountsModule *module, const QString &description,
                   const QString &refusal, const QList<Command> &commands, bool groupsChanged)
        : ElementTask(user, data)
        , _guard(user)
        , _module(module)
        , _refusal(refusal)
        , _commands(commands)
        , _groupsChanged(groupsChanged)
    {
        _taskDescription.setDescription(description);
    }

    void run() override
    {
        if (!_refusal.isEmpty()) {
            fail(_taskDescription, _refusal);
        } else {
            _taskDescription.setStatus(TaskDescription::Success);
            for (const Command &command : qAsConst(_commands)) {
                const KvtAdmin::ProgramResult result
                    = KvtAdmin::runProgram(command.program, command.arguments, command.input);
                if (!result.ok()) {
                    fail(_taskDescription, result.message(command.program));
                    break;
                }
            }
        }
        // Nothing of a password stays in memory longer than needed.
        for (Command &command : _commands)
            command.input.fill('\0');
        if (_elementData)
            _elementData->remove(passwordKey);
        ElementTask::run();
    }

    void afterRun() override
    {
        if (_taskDescription.status() == TaskDescription::Fail)
            return;
        if (_guard)
            _guard->performOperation(ReadPropertyOperation, nullptr, 0);
        if (_groupsChanged && _module && !_module->groups()->requireLoad())
            _module->groups()->performOperation(ReadContentOperation, nullptr, 0);
    }

private:
    QPointer<Element> _guard;
    QPointer<AccountsModule> _module;
    QString _refusal;
    QList<Command> _commands;
    bool _groupsChanged;
};

template <class Entry, class ElementClass>
void mergeChildren(AccountsModule *module, ContainerElement *parent, const QList<Entry> &entries,
                   const std::function<QString(const Entry &)> &key)
{
    QMap<QString, Entry> wanted;
    for (const Entry &entry : entries)
        wanted.insert(key(entry), entry);
    const QList<TreeNode *> children = parent->childNodes();
    for (TreeNode *node : children) {
        auto *element = static_cast<ElementClass *>(node);
        auto found = wanted.find(element->title());
        if (found == wanted.end()) {
            parent->removeOne(element);
            delete element;
        } else {
            element->setEntry(found.value());
            wanted.erase(found);
        }
    }
    for (const Entry &entry : qAsConst(wanted)) {
        int position = 0;
        while (position < parent->childNodesCount()
               && static_cast<Element *>(parent->childNodes().at(position))->title() < key(entry))
            ++position;
        parent->insert(position, new ElementClass(*module, entry));
    }
}

} // namespace

bool Accounts::PasswdEntry::parse(const QString &line, PasswdEntry *entry)
{
    const QStringList fields = line.split(QLatin1Char(':'));
    if (fields.size() != 7 || fields.at(0).isEmpty())
        return false;
    bool uidOk = false;
    bool gidOk = false;
    entry->login = fields.at(0);
    entry->uid = fields.at(2).toUInt(&uidOk);
    entry->gid = fields.at(3).toUInt(&gidOk);
    entry->gecos = fields.at(4);
    entry->home = fields.at(5);
    entry->shell = fields.at(6);
    return uidOk && gidOk;
}

bool Accounts::PasswdEntry::isListed(uint uidMin) const
{
    // 65534 is "nobody", an account of no person.
    return uid == 0 || (uid >= uidMin && uid != 65534);
}

bool Accounts::GroupEntry::parse(const QString &line, GroupEntry *entry)
{
    const QStringList fields = line.split(QLatin1Char(':'));
    if (fields.size() != 4 || fields.at(0).isEmpty())
        return false;
    bool gidOk = false;
    entry->name = fields.at(0);
    entry->gid = fields.at(2).toUInt(&gidOk);
    entry->members = fields.at(3).split(QLatin1Char(','), Qt::SkipEmptyParts);
    return gidOk;
}

QStringList Accounts::gecosFields(const QString &gecos)
{
    QStringList fields = gecos.split(QLatin1Char(','));
    for (QString &field : fields)
        field = field.trimmed();
    while (fields.size() < 4)
        fields << QString();
    return fields.mid(0, 4);
}

uint Accounts::firstHumanUid(const QString &loginDefs)
{
    QFile file(loginDefs);
    if (file.open(QIODevice::ReadOnly | QIODevice::Text)) {
        static const QRegularExpression uidMin(QStringLiteral("^\\s*UID_MIN\\s+(\\d+)\\s*$"));
        while (!file.atEnd()) {
            const QRegularExpressionMatch match = uidMin.match(QString::fromLocal8Bit(file.readLine()));
            if (match.hasMatch())
                return match.captured(1).toUInt();
        }
    }
    return 1000;
}

AccountsGroupElement::AccountsGroupElement(Module &module, const QString &type, const QString &title)
    : KvtAdmin::TopLevelGroup(module, type, title)
{
}

QString AccountsGroupElement::toolTipText() const
{
    return _elementType == Accounts::usersType ? AccountsModule::tr("root and the accounts of people")
                                               : AccountsModule::tr("The groups of this host");
}

UserElement::UserElement(Module &module, const Accounts::PasswdEntry &entry)
    : LoginElement(module, KvtAdmin::mayChangeSystem)
{
    _elementType = Accounts::userType;
    setTitle(entry.login);
    _elementData->insert(QStringLiteral("isLogin"), true);
    setEntry(entry);
}

void UserElement::setEntry(const Accounts::PasswdEntry &entry)
{
    _elementData->insert(QStringLiteral("user"), entry.login);
    _elementData->insert(QStringLiteral("uid"), entry.uid);
    _elementData->insert(QStringLiteral("gid"), entry.gid);
    _elementData->insert(gecosKey, entry.gecos);
    _elementData->insert(QStringLiteral("home"), entry.home);
    _elementData->insert(QStringLiteral("shell"), entry.shell);
    emitNodeDataChanged();
}

quint64 UserElement::availableOperations() const
{
    // The login operations are offered whatever the rights; the module
    // checks them before it changes anything. A change of groups is an update.
    return LoginElement::availableOperations() | (isEditable() ? quint64(UpdateOperation) : 0);
}

void UserElement::performOperation(OperationType type, ElementData *data, int flags)
{
    if (type == UpdateOperation)
        _module.performOperation(this, type, data, flags);
    else
        LoginElement::performOperation(type, data, flags);
}

QString UserElement::toolTipText() const
{
    const QString fullName = Accounts::gecosFields(_elementData->value(gecosKey).toString()).first();
    return fullName.isEmpty() ? title() : QStringLiteral("%1 (%2)").arg(title(), fullName);
}

GroupElement::GroupElement(Module &module, const Accounts::GroupEntry &entry)
    : OrdinaryElement(module, KvtAdmin::mayChangeSystem)
{
    _elementType = Accounts::groupType;
    setTitle(entry.name);
    _elementData = new ElementData;
    setEntry(entry);
}

void GroupElement::setEntry(const Accounts::GroupEntry &entry)
{
    _elementData->setName(entry.name);
    _elementData->insert(QStringLiteral("gid"), entry.gid);
    _elementData->insert(QStringLiteral("members"), entry.members);
    emitNodeDataChanged();
}

quint64 GroupElement::availableOperations() const
{
    // Groups are shown; creating and deleting them is not offered here.
    return ReadPropertyOperation;
}

void GroupElement::performOperation(OperationType type, ElementData *data, int flags)
{
    if (type == ReadPropertyOperation)
        OrdinaryElement::performOperation(type, data, flags);
}

QString GroupElement::toolTipText() const
{
    return AccountsModule::tr("Group %1 (GID %2)").arg(title()).arg(_elementData->value(QStringLiteral("gid")).toUInt());
}

AccountsModule::AccountsModule(QObject *parent)
    : Module(QStringLiteral("accounts"), parent, false)
{
    _expectedDepth = 1;
    QString description = tr("Local users and groups");
    if (!KvtAdmin::changesAllowed())
        description += QLatin1Char(' ') + tr("- read-only: start kvt-admin with --allow-changes to change them");
    _moduleData->insert(QStringLiteral("description"), description);

    _users = new AccountsGroupElement(*this, Accounts::usersType, tr("Users"));
    _groups = new AccountsGroupElement(*this, Accounts::groupsType, tr("Groups"));
    _elementNodes << _users << _groups;

    insertElementWidget(new NodesElementWidget(Accounts::usersType, *this, KvtAdmin::mayChangeSystem));
    insertElementWidget(new NodesElementWidget(Accounts::groupsType, *this, KvtAdmin::mayChangeSystem));
    insertElementWidget(new UserWidget(*this));
    insertElementWidget(new GroupWidget(*this));
    connectElementWidgets();
}

AccountsModule::~AccountsModule()
{
    _users->clearDelete();
    _groups->clearDelete();
    for (TreeNode *node : qAsConst(_elementNodes))
        node->reset();
    qDeleteAll(_elementNodes);
    _elementNodes.clear();
}

UserElement *AccountsModule::user(const QString &login) const
{
    for (TreeNode *node : _users->childNodes()) {
        if (static_cast<UserElement *>(node)->login() == login)
            return static_cast<UserElement *>(node);
    }
    return nullptr;
}

GroupElement *AccountsModule::group(const QString &name) const
{
    for (TreeNode *node : _groups->childNodes()) {
        if (static_cast<GroupElement *>(node)->title() == name)
            return static_cast<GroupElement *>(node);
    }
    return nullptr;
}

void AccountsModule::setUsers(const QList<Accounts::PasswdEntry> &entries)
{
    mergeChildren<Accounts::PasswdEntry, UserElement>(
        this, _users, entries, [](const Accounts::PasswdEntry &entry) { return entry.login; });
}

void AccountsModule::setGroups(const QList<Accounts::GroupEntry> &entries)
{
    mergeChildren<Accounts::GroupEntry, GroupElement>(
        this, _groups, entries, [](const Accounts::GroupEntry &entry) { return entry.name; });
}

void AccountsModule::performOperation(ContextOperation *context, OperationType type, ElementData *data,
                                      int flags)
{
    Module::performOperation(context, type, data, flags);
    Element *element = context ? context->elementContext() : nullptr;
    if (!element || &element->module() != this)
        return;

    if (element == _users || element == _groups) {
        if (type == ReadContentOperation)
            TaskObserver::instance()->performTask(
                new ReadAccountsTask(static_cast<AccountsGroupElement *>(element), this, element == _users));
        return;
    }
    if (auto *group = qobject_cast<GroupElement *>(element)) {
        if (type == ReadPropertyOperation)
            TaskObserver::instance()->performTask(new ReadGroupTask(group));
        return;
    }
    auto *user = qobject_cast<UserElement *>(element);
    if (!user)
        return;
    if (type == ReadPropertyOperation) {
        TaskObserver::instance()->performTask(new ReadUserTask(user));
        return;
    }
    if (type != Accounts::ChangeGecosOperation && type != Accounts::ChangePasswordOperation
        && type != UpdateOperation)
        return;
    // The login operations are offered to everybody: the rights are checked
    // here. The record is the caller's new one; the task takes it over.
    if (!data)
        return;
    if (!user->isEditable()) {
        delete data;
        return;
    }

    const QString login = user->login();
    QString refusal;
    if (!KvtAdmin::isSafeName(login))
        refusal = tr("'%1' cannot be passed to a program as a user name").arg(login);
    QList<Command> commands;
    QString description;

    if (type == Accounts::ChangeGecosOperation) {
        description = tr("Change the user information of %1").arg(login);
        const QStringList fields = Accounts::gecosFields(data->value(gecosKey).toString());
        static const char *const options[] = {"-f", "-r", "-w", "-h"};
        QStringList arguments;
        for (int i = 0; i < 4; ++i) {
            if (!KvtAdmin::isSafeText(fields.at(i)))
                refusal = tr("'%1' cannot be passed to chfn").arg(fields.at(i));
            arguments << QLatin1String(options[i]) << fields.at(i);
        }
        // The fourth field of the dialog is the fourth of the GECOS field,
        // which chfn names the home phone; anything after it is kept.
        commands << Command{QStringLiteral("chfn"), arguments << login, QByteArray()};
    } else if (type == Accounts::ChangePasswordOperation) {
        description = tr("Change the password of %1").arg(login);
        const QString password = data->value(passwordKey).toString();
        if (password.isEmpty())
            refusal = tr("The new password is empty");
        for (const QChar c : password) {
            if (c.category() == QChar::Other_Control)
                refusal = tr("The new password contains a control character");
        }
        // chpasswd reads "login:password" on its standard input: the
        // password never appears on a command line.
        commands << Command{QStringLiteral("chpasswd"), {}, (login + QLatin1Char(':') + password + QLatin1Char('\n')).toUtf8()};
    } else {
        description = tr("Change the groups of %1").arg(login);
        const QStringList add = data->value(addGroupsKey).toStringList();
        const QStringList remove = data->value(removeGroupsKey).toStringList();
        for (const QString &group : add + remove) {
            if (!KvtAdmin::isSafeName(group) || group.contains(QLatin1Char(',')))
                refusal = tr("'%1' cannot be passed to a program as a group name").arg(group);
        }
        if (!add.isEmpty())
            commands << Command{QStringLiteral("usermod"),
                                {QStringLiteral("-a"), QStringLiteral("-G"), add.join(QLatin1Char(',')), login},
                                QByteArray()};
        for (const QString &group : remove)
            commands << Command{QStringLiteral("gpasswd"), {QStringLiteral("-d"), login, group}, QByteArray()};
    }
    TaskObserver::instance()->performTask(
        new ChangeUserTask(user, data, this, description, refusal, commands, type == UpdateOperation));
}
