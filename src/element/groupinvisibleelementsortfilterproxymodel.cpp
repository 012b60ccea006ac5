// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "groupinvisibleelementsortfilterproxymodel.h"

#include "contextoperation.h"
#include "element.h"

namespace {

// Hides the nodes whose special flags have bit 1 (supplement elements).
const int hideMarkedNodes = 1;

} // namespace

GroupInvisibleElementSortFilterProxyModel::GroupInvisibleElementSortFilterProxyModel(QObject *parent)
    : GroupInvisibleElementSortFilterProxyModel(QSet<int>(), parent)
{
}

GroupInvisibleElementSortFilterProxyModel::GroupInvisibleElementSortFilterProxyModel(
    QSet<int> acceptColumns, QObject *parent)
    : ElementSortFilterProxyModel(std::move(acceptColumns), hideMarkedNodes, parent)
    , _groupElementType(ContextOperation::undefinedElementType)
{
}

GroupInvisibleElementSortFilterProxyModel::~GroupInvisibleElementSortFilterProxyModel() = default;

QString GroupInvisibleElementSortFilterProxyModel::groupElementType() const
{
    return _groupElementType;
}

void GroupInvisibleElementSortFilterProxyModel::setGroupElementType(const QString &type, bool force)
{
    if (!force && type == _groupElementType)
        return;
    _groupElementType = type;
    invalidateFilter();
}

bool GroupInvisibleElementSortFilterProxyModel::filterAcceptsRow(int sourceRow,
                                                                 const QModelIndex &sourceParent) const
{
    if (!ElementSortFilterProxyModel::filterAcceptsRow(sourceRow, sourceParent))
        return false;
    // Only "Undefined" means "every group". "All" is deliberately not
    // treated alike: existing callers rely on a filter on "All" to show only
    // the elements of a group of that name.
    if (_groupElementType == ContextOperation::undefinedElementType)
        return true;
    const QAbstractItemModel *source = sourceModel();
    const auto *elements = dynamic_cast<const ElementModelExtension *>(source);
    if (!elements)
        return true;
    const QModelIndex sourceIndex = source->index(sourceRow, 0, sourceParent);
    // An invalid index would name the root of the tree, which is no row.
    if (!sourceIndex.isValid())
        return true;
    const Element *element = elements->toElement(sourceIndex);
    if (!element)
        return true;
    return element->groupElementType() == _groupElementType;
}
