// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CONTAINERELEMENT_H
#define KVT_CONTAINERELEMENT_H

#include "element.h"

/*!
 * An element whose children are read from the system when it is first
 * expanded (canFetchMore()/fetchMore() with ReadContentOperation), and under
 * which new elements are created. It can switch how its children are shown
 * with a ChangeDisplayElementData given to ChangeDisplayOperation; the
 * module is not told of that switch.
 *
 * Offers ReadContentOperation, and CreateOperation too when editable.
 * Forwards ReadContentOperation and CreateOperation to the module.
 */
class KVTCOMMON_EXPORT ContainerElement : public Element
{
    Q_OBJECT

public:
    //! Creates a container whose children are still to be read.
    ContainerElement(Module &module, RightsPredicate rights);
    //! Destroys the element (see Element::~Element()).
    ~ContainerElement() override;

    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;

    /*! Marks the children to be read again at the next expansion. */
    void resetRequireLoad();
};

#endif // KVT_CONTAINERELEMENT_H
