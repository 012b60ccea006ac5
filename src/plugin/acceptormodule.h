// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ACCEPTORMODULE_H
#define KVT_ACCEPTORMODULE_H

#include "module.h"

/*!
 * A module that works on elements another module owns: its donor, the
 * module it hangs under in the module tree. The tree loader places it there
 * by the expected depth and expected parent id given to the constructor.
 *
 * An acceptor module has no force reread mode: it shows no check box and
 * keeps no settings.
 */
class KVTCOMMON_EXPORT AcceptorModule : public Module
{
    Q_OBJECT

public:
    /*!
     * Creates the module \a name, hung by the tree loader at \a expectedDepth under
     * the module whose id is \a expectedParentId (the donor), with \a description
     * in its module data.
     */
    AcceptorModule(const QString &name, int expectedDepth, const QString &expectedParentId,
                   const QString &description, QObject *parent = nullptr);
    //! Destroys the module.
    ~AcceptorModule() override;

    /*! The donor's element with the id \a name; null when there is none or
     *  the module does not hang under another module. */
    Element *elementFromDonor(const QString &name) const;
};

#endif // KVT_ACCEPTORMODULE_H
