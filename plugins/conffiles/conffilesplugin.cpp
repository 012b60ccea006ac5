// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// conffiles: edits line-oriented key/value configuration files ("key = value"
// or "key value", "#" comments) through the library's RegExpHandler, in tasks
// on the worker threads. The plugin to read for the whole flow: a container
// element read lazily, an edit widget read on show, update, create and delete
// tasks, force reread mode.

#include "conffilesmodule.h"

#include <kvt-common/plugin.h>

#include <QStandardPaths>

class ConfFilesPlugin : public Plugin
{
    Q_OBJECT
    Q_PLUGIN_METADATA(IID KVT_PLUGIN_IID)
    Q_INTERFACES(Plugin)

public:
    ConfFilesPlugin()
    {
        _name = tr("Configuration files");
        _description = tr("Reads and changes the keys of key/value configuration files");
        _availableOperationsClass = 1;
        _modules << new ConfFilesModule(this);
    }

    // Files are written back with the system cp, which keeps their owner
    // and mode; without it nothing could be saved.
    bool isValid() const override
    {
        return !QStandardPaths::findExecutable(QStringLiteral("cp")).isEmpty();
    }
};

#include "conffilesplugin.moc"
