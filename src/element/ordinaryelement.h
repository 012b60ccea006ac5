// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ORDINARYELEMENT_H
#define KVT_ORDINARYELEMENT_H

#include "element.h"

/*!
 * An element with properties of its own that are read, updated, created
 * and deleted through the module.
 *
 * Offers ReadPropertyOperation, and when editable also UpdateOperation and,
 * unless persistent, CreateOperation and DeleteOperation. Below a parent
 * element that offers ChangeDisplayOperation it offers that too, passes it
 * on to the parent (a click on one child switches the display of all its
 * siblings) and shows the parent's display variants as its own.
 */
class KVTCOMMON_EXPORT OrdinaryElement : public Element
{
    Q_OBJECT

public:
    //! Creates the element.
    OrdinaryElement(Module &module, RightsPredicate rights);
    //! Destroys the element (see Element::~Element()).
    ~OrdinaryElement() override;

    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;
    int displayChildrenVariant() const override;
    QStringList displayChildrenVariants() const override;

private:
    Element *displaySwitchingParent() const;
};

#endif // KVT_ORDINARYELEMENT_H
