// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_OPERATIONTYPE_H
#define KVT_OPERATIONTYPE_H

/*! \file operationtype.h
 * The operation codes of elements and element widgets.
 */

/*!
 * Operations that can be performed on an element or an element widget. Each
 * value is a single bit, so a set of operations is their bitwise or, kept in
 * a 64-bit unsigned value (see ContextOperation::availableOperations()).
 *
 * The bits 0x100, 0x200, 0x400 and 0x1000 to 0x10000 are free for plugins.
 */
enum OperationType {
    InsertedOperation = 0x1,        //!< the element has just been inserted into the element tree
    RemovedOperation = 0x2,         //!< the element has just been removed from the element tree
    CreateOperation = 0x4,          //!< create a new element
    ReadContentOperation = 0x8,     //!< read the element's children from the system
    ResetOperation = 0x10,          //!< the element tree has just been rebuilt
    ReadPropertyOperation = 0x20,   //!< read the element's own properties
    UpdateOperation = 0x40,         //!< write changed properties back to the system
    DeleteOperation = 0x80,         //!< delete the element from the system
    ChangeDisplayOperation = 0x800, //!< switch how a container's children are shown
    LoginExtraOperation1 = 0x20000, //!< login-specific; its meaning is the module's
    LoginExtraOperation2 = 0x40000  //!< second login-specific operation
};

#endif // KVT_OPERATIONTYPE_H
