// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_LOGINELEMENT_H
#define KVT_LOGINELEMENT_H

#include "element.h"

/*!
 * An element that stands for a login. Its data holds "user" (empty at
 * first) and "isLogin" (false at first). It offers and forwards reading its
 * content and properties and the two login-specific operations, whatever
 * the rights.
 */
class KVTCOMMON_EXPORT LoginElement : public Element
{
    Q_OBJECT

public:
    //! Creates the element with its record ("user" empty, "isLogin" false).
    LoginElement(Module &module, RightsPredicate rights);
    //! Destroys the element and its record.
    ~LoginElement() override;

    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;
};

#endif // KVT_LOGINELEMENT_H
