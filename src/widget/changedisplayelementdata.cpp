// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "changedisplayelementdata.h"

ChangeDisplayElementData::ChangeDisplayElementData()
    : ChangeDisplayElementData(0)
{
}

ChangeDisplayElementData::ChangeDisplayElementData(int displayType)
    : _displayType(displayType)
{
}

ChangeDisplayElementData::ChangeDisplayElementData(const ChangeDisplayElementData &other) = default;

ChangeDisplayElementData &
ChangeDisplayElementData::operator=(const ChangeDisplayElementData &other) = default;

ChangeDisplayElementData::~ChangeDisplayElementData() = default;
