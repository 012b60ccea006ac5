// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "serviceconfigureheavyelementdata.h"

ServiceConfigureHeavyElementData::ServiceConfigureHeavyElementData() = default;

// incompatibleModes is left empty on purpose: see the class comment.
ServiceConfigureHeavyElementData::ServiceConfigureHeavyElementData(
    const ServiceConfigureHeavyElementData &other)
    : ServiceLightElementData(other)
    , _scriptModeCommands(other._scriptModeCommands)
    , _headers(other._headers)
    , _descriptions(other._descriptions)
    , _tasks(other._tasks)
    , _user(other._user)
    , _password(other._password)
    , _checkedItems(other._checkedItems)
    , _uncheckedItems(other._uncheckedItems)
{
}

ServiceConfigureHeavyElementData &
ServiceConfigureHeavyElementData::operator=(const ServiceConfigureHeavyElementData &other)
{
    if (&other != this) {
        ServiceLightElementData::operator=(other);
        _scriptModeCommands = other._scriptModeCommands;
        _headers = other._headers;
        _descriptions = other._descriptions;
        _tasks = other._tasks;
        _user = other._user;
        _password = other._password;
        _checkedItems = other._checkedItems;
        _uncheckedItems = other._uncheckedItems;
        _incompatibleModes = other._incompatibleModes;
    }
    return *this;
}

ServiceConfigureHeavyElementData::~ServiceConfigureHeavyElementData() = default;
