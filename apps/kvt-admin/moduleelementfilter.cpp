// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#include "moduleelementfilter.h"

#include <kvt-common/element.h>
#include <kvt-common/module.h>

ModuleElementFilter::ModuleElementFilter(QObject *parent)
    : ElementSortFilterProxyModel(1, parent)
{
}

void ModuleElementFilter::setModule(Module *module)
{
    if (_module == module)
        return;
    _module = module;
    invalidateFilter();
}

bool ModuleElementFilter::filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const
{
    if (!ElementSortFilterProxyModel::filterAcceptsRow(sourceRow, sourceParent))
        return false;
    if (!_module || sourceParent.isValid())
        return true;
    const auto *source = dynamic_cast<const TreeNodeModelExtension *>(sourceModel());
    const TreeNode *node = source ? source->toTreeNode(sourceModel()->index(sourceRow, 0, sourceParent)) : nullptr;
    const auto *element = qobject_cast<const Element *>(node);
    if (!element)
        return true;
    for (const TreeNode *owner = &element->module(); owner; owner = owner->parentNode()) {
        if (owner == _module)
            return true;
    }
    return false;
}
