// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// accounts: local users and groups.

#include "accountsmodule.h"

#include <kvt-common/plugin.h>

#include <QStandardPaths>

class AccountsPlugin : public Plugin
{
    Q_OBJECT
    Q_PLUGIN_METADATA(IID KVT_PLUGIN_IID)
    Q_INTERFACES(Plugin)

public:
    AccountsPlugin()
        : _valid(!QStandardPaths::findExecutable(QStringLiteral("getent")).isEmpty())
    {
        _name = tr("Accounts");
        _description = tr("Local users and groups: user information, groups and passwords");
        if (!_valid)
            setProperty("unavailableReason", tr("The program getent is not installed."));
        _availableOperationsClass = 1;
        if (_valid)
            _modules << new AccountsModule(this);
    }

    bool isValid() const override { return _valid; }

private:
    bool _valid;
};

#include "accountsplugin.moc"
