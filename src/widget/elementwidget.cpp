// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementwidget.h"

#include "elementtask_p.h"
#include "elementwidget_p.h"

#include "element.h"

#include <QSet>
#include <QShowEvent>

namespace {

// Every element widget that exists, so that an element being destroyed can
// find the widgets that still point at it. The widget keeps a plain pointer
// (its layout is fixed); this table stands in for a guard. Never freed: a
// widget destroyed during static destruction still finds it.
QSet<ElementWidget *> &liveWidgets()
{
    static auto *widgets = new QSet<ElementWidget *>;
    return *widgets;
}

// Reaches the protected pointer of any widget from outside the class.
struct ElementWidgetAccess : ElementWidget
{
    static Element *ElementWidget::*elementField() { return &ElementWidgetAccess::_element; }
};

} // namespace

void KvtElementWidgets::elementDestroyed(const Element *element)
{
    if (!element)
        return;
    Element *ElementWidget::*field = ElementWidgetAccess::elementField();
    for (ElementWidget *widget : qAsConst(liveWidgets())) {
        // Only the pointer is cleared, no virtual call: the element is half
        // destroyed and the widget's own code must not be asked to look at it.
        if (widget->*field == element)
            widget->*field = nullptr;
    }
}

ElementWidget::ElementWidget(Module &module, RightsPredicate check, QWidget *parent)
    : QWidget(parent)
    , ContextOperation(ElementWidgetContextType, module, check)
    , _supplementElementWidgetType(undefinedElementType)
    , _priority(500)
    , _element(nullptr)
    , _role(NoElementRole)
{
    liveWidgets().insert(this);
}

ElementWidget::~ElementWidget()
{
    liveWidgets().remove(this);
    // Tasks still queued or running for this widget let go of it.
    ElementTaskPrivate::widgetDestroyed(this);
}

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
