// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "ordinaryelement.h"

#include "changedisplayelementdata.h"
#include "module.h"

OrdinaryElement::OrdinaryElement(Module &module, RightsPredicate rights)
    : Element(module, rights)
{
}

OrdinaryElement::~OrdinaryElement() = default;

Element *OrdinaryElement::displaySwitchingParent() const
{
    auto *parent = qobject_cast<Element *>(parentNode());
    if (parent && (parent->availableOperations() & ChangeDisplayOperation))
        return parent;
    return nullptr;
}

quint64 OrdinaryElement::availableOperations() const
{
    quint64 operations = ReadPropertyOperation;
    if (isEditable()) {
        operations |= UpdateOperation;
        if (!isPersistent())
            operations |= CreateOperation | DeleteOperation;
    }
    if (displaySwitchingParent())
        operations |= ChangeDisplayOperation;
    return operations;
}

void OrdinaryElement::performOperation(OperationType type, ElementData *data, int flags)
{
    switch (type) {
    case CreateOperation:
    case ReadPropertyOperation:
    case UpdateOperation:
    case DeleteOperation:
        _module.performOperation(this, type, data, flags);
        break;
    case ChangeDisplayOperation:
        if (Element *parent = displaySwitchingParent()) {
            if (dynamic_cast<ChangeDisplayElementData *>(data))
                parent->performOperation(type, data, flags);
        }
        break;
    default:
        break;
    }
}

int OrdinaryElement::displayChildrenVariant() const
{
    if (Element *parent = displaySwitchingParent())
        return parent->displayChildrenVariant();
    return Element::displayChildrenVariant();
}

QStringList OrdinaryElement::displayChildrenVariants() const
{
    if (Element *parent = displaySwitchingParent())
        return parent->displayChildrenVariants();
    return Element::displayChildrenVariants();
}
