// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_SUPPLEMENTMODULE_H
#define KVT_SUPPLEMENTMODULE_H

#include "module.h"

/*!
 * A module told about new elements of one element type, which it passes on
 * to a donor module so that the donor can react (add a page for the
 * supplement, for instance).
 *
 * Only the insertion of an element of the supplement's element type reaches
 * the donor; every other operation stops here, and, unlike other modules, a
 * supplement module does not hand operations on to its child modules.
 *
 * Like an acceptor module it has no force reread mode.
 */
class KVTCOMMON_EXPORT SupplementModule : public Module
{
    Q_OBJECT

public:
    /*!
     * Creates the module \a name, hung by the tree loader at \a expectedDepth under
     * the module whose id is \a expectedParentId, with \a description in its module
     * data. Insertions of elements of \a elementType are passed on to \a donor (not
     * owned).
     */
    SupplementModule(const QString &name, int expectedDepth, const QString &expectedParentId,
                     const QString &description, const QString &elementType, Module *donor,
                     QObject *parent = nullptr);
    //! Destroys the module.
    ~SupplementModule() override;

    /*!
     * Passes InsertedOperation of an element of supplementElementType() on to the donor; ignores the rest.
     */
    void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                          int flags) override;

    //! The module told about insertions; not owned.
    Module *donorModule() const { return _donorModule; }
    //! The element type whose insertions are passed on.
    QString supplementElementType() const { return _supplementElementType; }

protected:
    //! See donorModule().
    Module *_donorModule;
    //! See supplementElementType().
    QString _supplementElementType;
};

#endif // KVT_SUPPLEMENTMODULE_H
