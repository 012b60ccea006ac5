// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "containerelement.h"

#include "changedisplayelementdata.h"
#include "module.h"

ContainerElement::ContainerElement(Module &module, RightsPredicate rights)
    : Element(module, rights)
{
    _requireLoad = true;
}

ContainerElement::~ContainerElement() = default;

quint64 ContainerElement::availableOperations() const
{
    if (isEditable())
        return CreateOperation | ReadContentOperation;
    return ReadContentOperation;
}

void ContainerElement::performOperation(OperationType type, ElementData *data, int flags)
{
    switch (type) {
    case ReadContentOperation:
        _module.performOperation(this, type, data, flags);
        _requireLoad = false;
        break;
    case CreateOperation:
        // Forwarded whatever the rights: the offer is advisory and the
        // caller checks it.
        _module.performOperation(this, type, data, flags);
        break;
    case ChangeDisplayOperation:
        if (auto *display = dynamic_cast<ChangeDisplayElementData *>(data)) {
            _displayChildrenVariant = display->displayType();
            emitNodeChildsDataChanged();
        }
        break;
    default:
        break;
    }
}

void ContainerElement::resetRequireLoad()
{
    _requireLoad = true;
}
