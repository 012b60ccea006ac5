// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// The plugin of the plugin-loading benchmark, built 50 times, once per
// KVT_BENCH_PLUGIN_INDEX, with KVT_BENCH_MODULES modules each: module 0 of a
// plugin directly below the module root, the others below it.
#include <kvt-common/acceptormodule.h>
#include <kvt-common/plugin.h>

class BenchPlugin : public Plugin
{
    Q_OBJECT
    Q_PLUGIN_METADATA(IID KVT_PLUGIN_IID)
    Q_INTERFACES(Plugin)

public:
    BenchPlugin()
    {
        const int index = KVT_BENCH_PLUGIN_INDEX;
        _name = QStringLiteral("bench plugin %1").arg(index);
        _availableOperationsClass = quint64(1) << (index % 64);
        const QString top = QStringLiteral("p%1m0").arg(index);
        // Acceptor modules keep no force reread setting, so unloading does
        // not write the settings file a thousand times.
        _modules << new AcceptorModule(top, 1, QString(), QString(), this);
        for (int i = 1; i < KVT_BENCH_MODULES; ++i)
            _modules << new AcceptorModule(QStringLiteral("p%1m%2").arg(index).arg(i), 2, top,
                                           QString(), this);
    }
};

#include "bench_plugin_sample.moc"
