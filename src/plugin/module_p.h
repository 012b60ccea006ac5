// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_MODULE_P_H
#define KVT_MODULE_P_H

class Module;

namespace ModulePrivate {

// Modules whose destructor has started. A module's QObject children (its
// elements, as a rule) are destroyed after the module itself, and removing
// them from the element tree must not call into the dead module. A module
// made later at the same address takes the address off the list.
void markDying(const Module *module);
void markAlive(const Module *module);
bool isDying(const Module *module);

}

#endif
