#include "elementwidget.h"

#include "element.h"

#include <QShowEvent>

ElementWidget::ElementWidget(Module &module, RightsPredicate check, QWidget *parent)
    : QWidget(parent)
    , ContextOperation(ElementWidgetContextType, module, check)
    , _supplementElementWidgetType(undefinedElementType)
    , _priority(500)
    , _element(nullptr)
    , _role(NoElementRole)
{
}

ElementWidget::~ElementWidget() = default;

quint64 ElementWidget::availableOperations() const
{
    return 0;
}

void ElementWidget::performOperation(OperationType, ElementData *, int)
{
}

void ElementWidget::setAlternativeExpected(int)
{
}

void ElementWidget::setElement(Element *element, ElementWidgetRole role)
{
    _element = element;
    _role = role;
}

void ElementWidget::read()
{
}

QString ElementWidget::caption() const
{
    return _element ? _element->caption() : QString();
}

bool ElementWidget::priorityLessThen(const ElementWidget *a, const ElementWidget *b)
{
    return a->_priority < b->_priority;
}

void ElementWidget::showEvent(QShowEvent *event)
{
    QWidget::showEvent(event);
    // The window system re-shows a restored window spontaneously; only a
    // show asked for by the program means "display this element now".
    if (event && !event->spontaneous())
        read();
}
