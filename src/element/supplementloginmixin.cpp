// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "supplementloginmixin.h"

#include "element.h"
#include "elementdata.h"

SupplementLoginMixin::SupplementLoginMixin(Element *element)
    : _element(element)
{
}

int SupplementLoginMixin::treeNodeSpecialFlags(int flags) const
{
    if (!_element)
        return flags;
    const auto *parent = qobject_cast<const Element *>(_element->parentNode());
    if (!parent || !parent->elementData())
        return flags;
    if (parent->elementData()->value(QStringLiteral("isLogin"), false).toBool())
        return flags;
    return flags | 1;
}
