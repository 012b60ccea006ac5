// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CHOICETREENODEPROXYHELPER_P_H
#define KVT_CHOICETREENODEPROXYHELPER_P_H

#include <QModelIndex>

class QAbstractItemModel;

namespace ChoiceProxyHelper {

// Whether the row's ticked state in a ChoiceTreeNodeProxyModel equals
// \a checked; true for every row of any other model.
bool hasChoiceState(const QAbstractItemModel *source, int row, const QModelIndex &parent, bool checked);

} // namespace ChoiceProxyHelper

#endif // KVT_CHOICETREENODEPROXYHELPER_P_H
