// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// services: the host's services, with their state, status output and the
// Start, Stop, Restart and Reload actions.

#include "../shared/admintools.h"
#include "servicebackend.h"
#include "servicesmodule.h"

#include <kvt-common/plugin.h>

class ServicesPlugin : public Plugin
{
    Q_OBJECT
    Q_PLUGIN_METADATA(IID KVT_PLUGIN_IID)
    Q_INTERFACES(Plugin)

public:
    ServicesPlugin()
        : _backend(ServiceBackend::detect())
    {
        _name = tr("Services");
        _description = _backend.isValid() ? tr("Start, stop, restart and reload the services of this host")
                                          : _backend.unavailableReason();
        // Read by the plugin list when the plugin is refused.
        setProperty("unavailableReason", _backend.unavailableReason());
        _availableOperationsClass = 1;
        if (_backend.isValid())
            _modules << new ServicesModule(_backend, this);
    }

    bool isValid() const override { return _backend.isValid(); }

private:
    ServiceBackend _backend;
};

#include "servicesplugin.moc"
