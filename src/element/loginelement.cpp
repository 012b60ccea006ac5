// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "loginelement.h"

#include "elementdata.h"
#include "module.h"

namespace {
constexpr quint64 loginOperations = ReadContentOperation | ReadPropertyOperation
    | LoginExtraOperation1 | LoginExtraOperation2;
}

LoginElement::LoginElement(Module &module, RightsPredicate rights)
    : Element(module, rights)
{
    _elementData = new ElementData;
    _elementData->insert(QStringLiteral("user"), QString());
    _elementData->insert(QStringLiteral("isLogin"), false);
}

LoginElement::~LoginElement() = default;

quint64 LoginElement::availableOperations() const
{
    return loginOperations;
}

void LoginElement::performOperation(OperationType type, ElementData *data, int flags)
{
    if (loginOperations & quint64(type))
        _module.performOperation(this, type, data, flags);
}
