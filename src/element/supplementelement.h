// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_SUPPLEMENTELEMENT_H
#define KVT_SUPPLEMENTELEMENT_H

#include "element.h"

/*!
 * An element that adds properties to another element: it is only read and
 * updated, and marks itself with the special flag 1 so that filters can
 * leave it out of plain element lists.
 */
class KVTCOMMON_EXPORT SupplementElement : public Element
{
    Q_OBJECT

public:
    //! Creates the element.
    SupplementElement(Module &module, RightsPredicate rights);
    //! Destroys the element (see Element::~Element()).
    ~SupplementElement() override;

    //! The special flag 1: hidden by the proxies that leave supplements out.
    int treeNodeSpecialFlags() const override;
    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;
};

#endif // KVT_SUPPLEMENTELEMENT_H
