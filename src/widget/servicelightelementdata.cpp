// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "servicelightelementdata.h"

#include <QObject>

ServiceLightElementData::ServiceLightElementData()
    : _state(false)
{
}

ServiceLightElementData::ServiceLightElementData(const ServiceLightElementData &other) = default;

ServiceLightElementData &ServiceLightElementData::operator=(const ServiceLightElementData &other)
{
    if (&other != this) {
        ElementData::operator=(other);
        _state = other._state;
        _textState = other._textState;
    }
    return *this;
}

ServiceLightElementData::~ServiceLightElementData() = default;

void ServiceLightElementData::setState(bool state, const QString &textState)
{
    _state = state;
    // The words live in the QObject context: existing translations of the
    // service plugins share them.
    if (textState.isEmpty())
        _textState = state ? QObject::tr("started") : QObject::tr("stopped");
    else
        _textState = textState;
}
