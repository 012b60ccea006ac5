// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "plugin.h"

Plugin::Plugin(QObject *parent)
    : QObject(parent)
    , _availableOperationsClass(0)
{
}

Plugin::~Plugin() = default;

bool Plugin::isValid() const
{
    return true;
}
