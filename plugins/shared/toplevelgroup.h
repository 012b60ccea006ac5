// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ADMIN_TOPLEVELGROUP_H
#define KVT_ADMIN_TOPLEVELGROUP_H

#include "admintools.h"

#include <kvt-common/containerelement.h>

namespace KvtAdmin {

/*!
 * A persistent node directly below a module ("Services", "PostgreSQL
 * clusters", "Users"...): a container whose children are read on the first
 * reset after the element tree is built, so the list is there before the user
 * expands it. Nothing is created or deleted at this level. It changes the
 * machine only through its children, with the rights of mayChangeSystem().
 *
 * No Q_OBJECT here (the header is shared by plugins without a moc step of its
 * own); each plugin's subclass declares its own.
 */
class TopLevelGroup : public ContainerElement
{
public:
    TopLevelGroup(Module &module, const QString &type, const QString &title)
        : ContainerElement(module, mayChangeSystem)
    {
        _elementType = type;
        _groupElementType = type;
        setTitle(title);
        _expectedDepth = 1;
    }

    quint64 availableOperations() const override { return ReadContentOperation | ResetOperation; }

    void performOperation(OperationType type, ElementData *data, int flags) override
    {
        if (type == ResetOperation) {
            if (canFetchMore())
                fetchMore();
            return;
        }
        if (type == ReadContentOperation)
            ContainerElement::performOperation(type, data, flags);
    }
};

} // namespace KvtAdmin

#endif // KVT_ADMIN_TOPLEVELGROUP_H
