// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTMODELEXTENSION_H
#define KVT_ELEMENTMODELEXTENSION_H

#include "treenodemodelextension.h"

class Element;

/*!
 * Turns a model index, a selection range or a selection back into the
 * Element behind it, whichever element model or element proxy a view holds.
 *
 * The node lookup itself is the model's own TreeNodeModelExtension mapping:
 * the extension is a virtual base, so a class that derives from a tree-node
 * model or proxy and from this class has a single mapping, the one the model
 * implements.
 *
 * Every lookup gives null when there is no node or the node is not an
 * Element: an invalid index stands for the root of the tree, which is not
 * an element; an index of another model stands for nothing.
 */
class KVTCOMMON_EXPORT ElementModelExtension : public virtual TreeNodeModelExtension
{
public:
    //! Creates the extension.
    ElementModelExtension();
    //! Destroys the extension.
    virtual ~ElementModelExtension();

    //! The element of \a index, or null.
    Element *toElement(const QModelIndex &index) const;
    //! The element of the first index of \a range that has a node, or null.
    Element *toElement(const QItemSelectionRange &range) const;
    //! The element of the first range of \a selection that has a node, or null.
    Element *toElement(const QItemSelection &selection) const;
};

#endif // KVT_ELEMENTMODELEXTENSION_H
