// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ADMIN_ACCOUNTSMODULE_H
#define KVT_ADMIN_ACCOUNTSMODULE_H

#include "../shared/toplevelgroup.h"

#include <kvt-common/containerelement.h>
#include <kvt-common/loginelement.h>
#include <kvt-common/module.h>
#include <kvt-common/ordinaryelement.h>

#include <QStringList>

namespace Accounts {

const QString usersType = QStringLiteral("accountsUsers");
const QString groupsType = QStringLiteral("accountsGroups");
const QString userType = QStringLiteral("accountsUser");
const QString groupType = QStringLiteral("accountsGroup");

// What the two login operations mean here.
//! LoginExtraOperation1: set the GECOS field to the record's "gecos".
const OperationType ChangeGecosOperation = LoginExtraOperation1;
//! LoginExtraOperation2: set the password to the record's "password".
const OperationType ChangePasswordOperation = LoginExtraOperation2;
// UpdateOperation: add the user to the record's "addGroups" and remove it
// from its "removeGroups".
// The three take over the record they are given (a new one), as a task does.

/*! One line of the passwd database. */
struct PasswdEntry
{
    QString login;
    uint uid = 0;
    uint gid = 0;
    QString gecos;
    QString home;
    QString shell;

    /*! Parses "login:x:uid:gid:gecos:home:shell"; false for anything else. */
    static bool parse(const QString &line, PasswdEntry *entry);
    /*! root and the accounts of people (UID from \a uidMin up, not nobody). */
    bool isListed(uint uidMin) const;
};

/*! One line of the group database. */
struct GroupEntry
{
    QString name;
    uint gid = 0;
    QStringList members;

    static bool parse(const QString &line, GroupEntry *entry);
};

/*! The four GECOS sub-fields of \a gecos, in the order full name, room,
 *  work phone, other; blanks around each are dropped. */
QStringList gecosFields(const QString &gecos);

/*! The first UID of people's accounts on this host (UID_MIN of
 *  /etc/login.defs, 1000 without it). */
uint firstHumanUid(const QString &loginDefs = QStringLiteral("/etc/login.defs"));

} // namespace Accounts

/*! A persistent node ("Users" or "Groups") whose children are read from the
 *  account databases. */
class AccountsGroupElement : public KvtAdmin::TopLevelGroup
{
    Q_OBJECT

public:
    AccountsGroupElement(Module &module, const QString &type, const QString &title);
    QString toolTipText() const override;
};

/*! A local user. Its record holds "user" (the login), "isLogin" (true),
 *  "uid", "gid", "gecos", "home" and "shell". */
class UserElement : public LoginElement
{
    Q_OBJECT

public:
    UserElement(Module &module, const Accounts::PasswdEntry &entry);
    QString login() const { return title(); }
    void setEntry(const Accounts::PasswdEntry &entry);
    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;
    QString toolTipText() const override;
};

/*! A local group. Its record holds "name", "gid" and "members". */
class GroupElement : public OrdinaryElement
{
    Q_OBJECT

public:
    GroupElement(Module &module, const Accounts::GroupEntry &entry);
    void setEntry(const Accounts::GroupEntry &entry);
    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;
    QString toolTipText() const override;
};

/*!
 * The local accounts: users (root and people) and groups. An administrator
 * (with kvt-admin's --allow-changes) changes a user's GECOS field, groups and
 * password; everybody else only reads.
 */
class AccountsModule : public Module
{
    Q_OBJECT

public:
    explicit AccountsModule(QObject *parent);
    ~AccountsModule() override;

    void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                          int flags) override;

    AccountsGroupElement *users() const { return _users; }
    AccountsGroupElement *groups() const { return _groups; }
    UserElement *user(const QString &login) const;
    GroupElement *group(const QString &name) const;

    void setUsers(const QList<Accounts::PasswdEntry> &entries);
    void setGroups(const QList<Accounts::GroupEntry> &entries);

private:
    AccountsGroupElement *_users;
    AccountsGroupElement *_groups;
};

#endif // KVT_ADMIN_ACCOUNTSMODULE_H
