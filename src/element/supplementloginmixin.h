// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_SUPPLEMENTLOGINMIXIN_H
#define KVT_SUPPLEMENTLOGINMIXIN_H

#include "kvtcommon_export.h"

class Element;

/*!
 * Helps a plugin element that supplements a login: while the element's
 * parent is not a login (its data says "isLogin" is false or does not say),
 * the element marks itself with the special flag 1.
 *
 * \code
 * int treeNodeSpecialFlags() const override
 * {
 *     return _loginMixin.treeNodeSpecialFlags(SupplementElement::treeNodeSpecialFlags());
 * }
 * \endcode
 */
class KVTCOMMON_EXPORT SupplementLoginMixin
{
public:
    //! Creates the helper of \a element (not owned), normally the element that holds it.
    explicit SupplementLoginMixin(Element *element);

    /*! \a flags, with the special flag 1 set when the element's parent element has data
     *  whose "isLogin" is not true. */
    int treeNodeSpecialFlags(int flags) const;

    //! The element the helper serves.
    Element *element() const { return _element; }

protected:
    //! See element().
    Element *_element;
};

#endif // KVT_SUPPLEMENTLOGINMIXIN_H
