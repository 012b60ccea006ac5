// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "supplementelement.h"

#include "module.h"

SupplementElement::SupplementElement(Module &module, RightsPredicate rights)
    : Element(module, rights)
{
}

SupplementElement::~SupplementElement() = default;

int SupplementElement::treeNodeSpecialFlags() const
{
    return 1;
}

quint64 SupplementElement::availableOperations() const
{
    if (isEditable())
        return ReadPropertyOperation | UpdateOperation;
    return ReadPropertyOperation;
}

void SupplementElement::performOperation(OperationType type, ElementData *data, int flags)
{
    if (type == ReadPropertyOperation || type == UpdateOperation)
        _module.performOperation(this, type, data, flags);
}
