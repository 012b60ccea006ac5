// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTWIDGET_P_H
#define KVT_ELEMENTWIDGET_P_H

class Element;

namespace KvtElementWidgets {

// Called by an element that is being destroyed: every element widget that
// still points at it lets go of it (its element becomes null), so that no
// widget, tab or caption reaches the element afterwards.
void elementDestroyed(const Element *element);

} // namespace KvtElementWidgets

#endif // KVT_ELEMENTWIDGET_P_H
