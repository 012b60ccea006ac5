// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementdata.h"

namespace {
const QString nameKey = QStringLiteral("name");
}

ElementData::ElementData() = default;

ElementData::ElementData(const ElementData &other) = default;

ElementData &ElementData::operator=(const ElementData &other) = default;

ElementData::~ElementData() = default;

void ElementData::configureParams()
{
}

QString ElementData::name() const
{
    return value(nameKey).toString();
}

void ElementData::setName(const QString &name)
{
    insert(nameKey, name);
}

ElementData &ElementData::importFrom(const ElementData &other)
{
    if (&other == this)
        return *this;
    // The walk is over our own keys: inserting under an existing key never
    // changes the key set, so iterating in place is safe.
    for (auto it = begin(); it != end(); ++it) {
        const auto found = other.constFind(it.key());
        if (found != other.constEnd())
            it.value() = found.value();
    }
    return *this;
}
