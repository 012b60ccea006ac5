// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// postgresql: the host's PostgreSQL clusters and their database users.

#include "postgresqlmodule.h"

#include <kvt-common/plugin.h>

#include <QStandardPaths>

class PostgresqlPlugin : public Plugin
{
    Q_OBJECT
    Q_PLUGIN_METADATA(IID KVT_PLUGIN_IID)
    Q_INTERFACES(Plugin)

public:
    PostgresqlPlugin()
        : _valid(!QStandardPaths::findExecutable(QStringLiteral("pg_lsclusters")).isEmpty())
    {
        _name = tr("PostgreSQL");
        _description = tr("Start PostgreSQL clusters, create and drop their users");
        if (!_valid)
            setProperty("unavailableReason", tr("The program pg_lsclusters is not installed."));
        _availableOperationsClass = 1;
        if (_valid)
            _modules << new PostgresqlModule(this);
    }

    bool isValid() const override { return _valid; }

private:
    bool _valid;
};

#include "postgresqlplugin.moc"
