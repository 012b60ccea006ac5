// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_KVTLOGGING_P_H
#define KVT_KVTLOGGING_P_H

#include <QLoggingCategory>

// One logging category per subsystem. Everything the library logs goes
// through these, so a host can switch a subsystem's messages on or off with
// QT_LOGGING_RULES (for example "kvt.task.debug=true").
Q_DECLARE_LOGGING_CATEGORY(KVT_TREENODE)
Q_DECLARE_LOGGING_CATEGORY(KVT_PLUGIN)
Q_DECLARE_LOGGING_CATEGORY(KVT_ELEMENT)
Q_DECLARE_LOGGING_CATEGORY(KVT_TASK)
Q_DECLARE_LOGGING_CATEGORY(KVT_WIDGET)
Q_DECLARE_LOGGING_CATEGORY(KVT_SYSTEM)

#endif // KVT_KVTLOGGING_P_H
