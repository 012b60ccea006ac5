// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTCONTAINER_H
#define KVT_ELEMENTCONTAINER_H

#include "nodecontainer.h"

/*!
 * The element tree of all loaded modules together, under one
 * ElementRootTreeNode, with the model that shows it.
 *
 * The application calls pluginContainerReset() whenever the plugin
 * container has (re)loaded its modules. Requests to make an element current
 * or to expand it, raised anywhere in the tree, are re-emitted by the
 * container.
 */
class KVTCOMMON_EXPORT ElementContainer : public NodeContainer
{
    Q_OBJECT

public:
    //! Creates an empty element tree and its ElementModel, both owned by the container.
    explicit ElementContainer(QObject *parent = nullptr);
    //! Destroys the container, the root and the model; the elements belong to their modules.
    ~ElementContainer() override;

    /*!
     * Gathers the element nodes of every module below \a modulesRoot into
     * the element tree, resets the model and then performs ResetOperation
     * on each top-level element that offers it: that is when modules start
     * their first read. A null \a modulesRoot leaves the tree as it is and
     * only resets the model.
     */
    void pluginContainerReset(const TreeNode *modulesRoot);
};

#endif // KVT_ELEMENTCONTAINER_H
