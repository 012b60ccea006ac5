// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PLUGINCONTAINER_P_H
#define KVT_PLUGINCONTAINER_P_H

class PluginContainer;

namespace KvtPluginLoading {

// Whether \a container is inside loadPlugins() (events are processed during
// a load, so other code may run meanwhile).
bool isLoading(const PluginContainer *container);

} // namespace KvtPluginLoading

#endif // KVT_PLUGINCONTAINER_P_H
