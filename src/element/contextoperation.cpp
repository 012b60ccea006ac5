#include "contextoperation.h"

#include "element.h"

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
