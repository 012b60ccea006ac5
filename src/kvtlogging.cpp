// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "kvtlogging_p.h"

Q_LOGGING_CATEGORY(KVT_TREENODE, "kvt.treenode", QtInfoMsg)
Q_LOGGING_CATEGORY(KVT_PLUGIN, "kvt.plugin", QtInfoMsg)
Q_LOGGING_CATEGORY(KVT_ELEMENT, "kvt.element", QtInfoMsg)
Q_LOGGING_CATEGORY(KVT_TASK, "kvt.task", QtInfoMsg)
Q_LOGGING_CATEGORY(KVT_WIDGET, "kvt.widget", QtInfoMsg)
Q_LOGGING_CATEGORY(KVT_SYSTEM, "kvt.system", QtInfoMsg)
