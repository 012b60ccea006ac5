// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "choicetreenodeproxyhelper_p.h"

#include "choicetreenodeproxymodel.h"

namespace ChoiceProxyHelper {

bool hasChoiceState(const QAbstractItemModel *source, int row, const QModelIndex &parent, bool checked)
{
    const auto *choice = qobject_cast<const ChoiceTreeNodeProxyModel *>(source);
    if (!choice)
        return true;
    const QModelIndex nameIndex = choice->index(row, choice->nameColumn(), parent);
    const QVariant value = nameIndex.data(choice->choiceRole());
    if (choice->choiceRole() == Qt::CheckStateRole)
        return (value.toInt() == Qt::Checked) == checked;
    return value.toBool() == checked;
}

} // namespace ChoiceProxyHelper
