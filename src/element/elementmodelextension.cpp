// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementmodelextension.h"

#include "element.h"

ElementModelExtension::ElementModelExtension() = default;

ElementModelExtension::~ElementModelExtension() = default;

Element *ElementModelExtension::toElement(const QModelIndex &index) const
{
    return qobject_cast<Element *>(toTreeNode(index));
}

Element *ElementModelExtension::toElement(const QItemSelectionRange &range) const
{
    return qobject_cast<Element *>(toTreeNode(range));
}

Element *ElementModelExtension::toElement(const QItemSelection &selection) const
{
    // The first node of the selection decides, even when it is no element:
    // the selection names that node, not the first element somewhere in it.
    return qobject_cast<Element *>(toTreeNode(selection));
}
