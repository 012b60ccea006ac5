// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "supplementmodule.h"

#include "element.h"
#include "elementdata.h"

SupplementModule::SupplementModule(const QString &name, int expectedDepth,
                                   const QString &expectedParentId, const QString &description,
                                   const QString &elementType, Module *donor, QObject *parent)
    : Module(name, parent, false)
    , _donorModule(donor)
    , _supplementElementType(elementType)
{
    _expectedDepth = expectedDepth;
    _expectedParentId = expectedParentId;
    // No force reread mode: no check box in the "Reread" column, and nothing
    // for the destructor to save.
    _moduleData->remove(QStringLiteral("paranoid"));
    _moduleData->insert(QStringLiteral("description"), description);
}

SupplementModule::~SupplementModule() = default;

void SupplementModule::performOperation(ContextOperation *context, OperationType type,
                                        ElementData *data, int flags)
{
    // Widgets' operations are none of a supplement's business.
    if (!context || context->contextType() != ContextOperation::ElementContextType)
        return;
    Element *element = context->elementContext();
    if (!element)
        return;
    if (type == InsertedOperation && element->elementType() == _supplementElementType
        && _donorModule)
        _donorModule->performOperation(context, InsertedOperation, data, flags);
    // Nothing goes on to child modules, on purpose.
}
