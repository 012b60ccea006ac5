// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementtreeops_p.h"

#include "element.h"
#include "module.h"
#include "module_p.h"

#include <QPointer>
#include <QSet>
#include <QVector>

namespace {

void notify(const QVector<QPointer<Element>> &elements, OperationType type)
{
    // Guarded pointers: the module's answer to one notification may destroy
    // the elements that are still to be told.
    for (const QPointer<Element> &element : elements) {
        if (!element)
            continue;
        Module &module = element->module();
        // A module tears down the elements it owns after its own destructor
        // has run; such a module cannot be told anything any more.
        if (ModulePrivate::isDying(&module))
            continue;
        module.performOperation(element.data(), type, nullptr, 0);
    }
}

} // namespace

void ElementTreeOps::insert(TreeNode *self, int position, const QList<TreeNode *> &nodes)
{
    // The same nodes TreeNode::insert takes: no null, not the node itself,
    // each once.
    QVector<QPointer<Element>> inserted;
    QSet<TreeNode *> seen;
    seen.reserve(nodes.size());
    for (TreeNode *node : nodes) {
        if (!node || node == self || seen.contains(node))
            continue;
        seen.insert(node);
        if (auto *element = qobject_cast<Element *>(node))
            inserted.append(element);
    }
    self->TreeNode::insert(position, nodes);
    notify(inserted, InsertedOperation);
}

void ElementTreeOps::removeAt(TreeNode *self, int position, int count)
{
    const int size = self->childNodesCount();
    if (size == 0 || position < 0 || position >= size || count < 1)
        return;
    count = qMin(count, size - position);

    QVector<QPointer<Element>> removed;
    for (int i = position; i < position + count; ++i) {
        if (auto *element = qobject_cast<Element *>(self->childNodes().at(i)))
            removed.append(element);
    }
    self->TreeNode::removeAt(position, count);
    notify(removed, RemovedOperation);
}
