// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#ifndef CONFFILES_CONFFILESMODULE_H
#define CONFFILES_CONFFILESMODULE_H

#include <kvt-common/module.h>

#include <QStringList>

/*!
 * The configuration files module: one container element per managed file,
 * one element per key line of a file.
 *
 * The files come from the settings key "conffiles/files" (a list of paths);
 * without it, those of /etc/adduser.conf and /etc/login.defs that exist.
 * Every operation on an element starts a task; nothing touches a file in the
 * interface thread.
 */
class ConfFilesModule : public Module
{
    Q_OBJECT

public:
    static const char filesSettingsKey[];

    explicit ConfFilesModule(QObject *parent);
    ~ConfFilesModule() override;

    QStringList files() const { return _files; }

    /*!
     * Records handed in with CreateOperation, UpdateOperation and
     * ReadContentOperation are owned by the module (they go to the task, or
     * are deleted); others (ChangeDisplayOperation) belong to the caller.
     */
    void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                          int flags) override;

private:
    QStringList _files;
};

#endif
