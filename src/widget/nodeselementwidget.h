// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_NODESELEMENTWIDGET_H
#define KVT_NODESELEMENTWIDGET_H

#include "listelementwidget.h"

/*!
 * A plain list of the children of an element (the first level only,
 * without supplement elements), without header. Double-clicking an entry
 * makes that element the current node of the tree.
 *
 * The element read first stays the listed root: later reads, also for
 * another element, change nothing.
 */
class KVTCOMMON_EXPORT NodesElementWidget : public ListElementWidget
{
    Q_OBJECT

public:
    //! Creates the widget with element type \a type; see ListElementWidget.
    NodesElementWidget(const QString &type, Module &module, RightsPredicate check,
                       QWidget *parent = nullptr);
    //! Destroys the widget.
    ~NodesElementWidget() override;

    //! Makes the element the listed root on the first read; later reads change nothing.
    void read() override;

public Q_SLOTS:
    //! Makes the element of \a index the current node of the tree.
    void choiceElement(const QModelIndex &index);
    //! Relays the view's context menu request (see ListElementWidget).
    void customContextMenuRequest(const QPoint &pos);
};

#endif // KVT_NODESELEMENTWIDGET_H
