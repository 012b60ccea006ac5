// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "contextoperation.h"

#include "element.h"
#include "elementwidget.h"

const QString ContextOperation::undefinedElementType = QStringLiteral("Undefined");
const QString ContextOperation::allElementType = QStringLiteral("All");

ContextOperation::ContextOperation(ContextType contextType, Module &module, RightsPredicate rights)
    : _module(module)
    , _rightsPredicate(rights)
    , _elementType(undefinedElementType)
    , _contextType(contextType)
{
}

ContextOperation::~ContextOperation() = default;

quint64 ContextOperation::availableOperations() const
{
    return 0;
}

void ContextOperation::performOperation(OperationType, ElementData *, int)
{
}

bool ContextOperation::isEditable() const
{
    return _rightsPredicate && _rightsPredicate(_module);
}

Element *ContextOperation::elementContext()
{
    return dynamic_cast<Element *>(this);
}

ElementWidget *ContextOperation::elementWidgetContext()
{
    return dynamic_cast<ElementWidget *>(this);
}

QString ContextOperation::caption() const
{
    if (const auto *widget = dynamic_cast<const ElementWidget *>(this))
        return widget->caption();
    if (const auto *element = dynamic_cast<const Element *>(this))
        return element->title();
    return QString();
}
