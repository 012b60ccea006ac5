// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "wrappergroupbox.h"

#include <QHBoxLayout>
#include <QStackedWidget>

namespace {

// The inner stack is the only item of the frame's layout; it is found there
// rather than kept in a member.
QStackedWidget *stackOf(const QGroupBox *box)
{
    const QLayout *layout = box->layout();
    QLayoutItem *item = layout ? layout->itemAt(0) : nullptr;
    return item ? qobject_cast<QStackedWidget *>(item->widget()) : nullptr;
}

} // namespace

WrapperGroupBox::WrapperGroupBox(QWidget *parent)
    : QGroupBox(parent)
{
    auto *layout = new QHBoxLayout(this);
    layout->setDirection(QBoxLayout::LeftToRight);
    layout->addWidget(new QStackedWidget(this));
}

WrapperGroupBox::~WrapperGroupBox()
{
    removeWidget();
}

void WrapperGroupBox::insertWidget(QWidget *widget)
{
    removeWidget();
    if (QStackedWidget *stack = widget ? stackOf(this) : nullptr)
        stack->insertWidget(0, widget);
}

void WrapperGroupBox::removeWidget()
{
    QStackedWidget *stack = stackOf(this);
    if (!stack || stack->count() == 0)
        return;
    QWidget *widget = stack->widget(0);
    stack->removeWidget(widget);
    // Still a child of the stack, the widget would die with the frame.
    widget->setParent(nullptr);
}

QWidget *WrapperGroupBox::widget() const
{
    const QStackedWidget *stack = stackOf(this);
    return stack ? stack->widget(0) : nullptr;
}
