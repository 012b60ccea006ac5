// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "record.h"

Record::Record()
    : _changed(false)
{
}

Record::~Record() = default;
