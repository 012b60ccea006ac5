// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "supplementelementselementwidget.h"

SupplementElementsElementWidget::SupplementElementsElementWidget(const QString &type,
                                                                 const QString &title,
                                                                 Module &module,
                                                                 RightsPredicate check,
                                                                 QWidget *parent)
    : ElementsElementWidget(type, module, check, parent)
{
    _priority = 750;
    _supplementElementWidgetType = allElementType;
    setWindowTitle(title);
}

SupplementElementsElementWidget::~SupplementElementsElementWidget() = default;
