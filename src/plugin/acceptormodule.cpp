// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "acceptormodule.h"

#include "elementdata.h"

AcceptorModule::AcceptorModule(const QString &name, int expectedDepth,
                               const QString &expectedParentId, const QString &description,
                               QObject *parent)
    : Module(name, parent, false)
{
    _expectedDepth = expectedDepth;
    _expectedParentId = expectedParentId;
    // No force reread mode: no check box in the "Reread" column, and nothing
    // for the destructor to save.
    _moduleData->remove(QStringLiteral("paranoid"));
    _moduleData->insert(QStringLiteral("description"), description);
}

AcceptorModule::~AcceptorModule() = default;

Element *AcceptorModule::elementFromDonor(const QString &name) const
{
    const auto *donor = qobject_cast<const Module *>(parentNode());
    return donor ? donor->element(name) : nullptr;
}
