// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// The plugin written by the documentation's plugin snippets, built as a
// plugin of its own so that the host snippet loads it as it stands.

#include "globalsnippets.h"

#include "read-task.inc"
