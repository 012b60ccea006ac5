// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_SUPPLEMENTELEMENTSELEMENTWIDGET_H
#define KVT_SUPPLEMENTELEMENTSELEMENTWIDGET_H

#include "elementselementwidget.h"

/*!
 * The list of ElementsElementWidget offered as a supplement tab for any
 * element type: its supplement type is ContextOperation::allElementType,
 * its priority 750 (after the element's own widget), and its window title,
 * the tab's title, is \a title.
 */
class KVTCOMMON_EXPORT SupplementElementsElementWidget : public ElementsElementWidget
{
    Q_OBJECT

public:
    /*!
     * Creates the widget with element type \a type, standing for supplements of
     * that type, with \a title as its window title (the tab title).
     */
    SupplementElementsElementWidget(const QString &type, const QString &title, Module &module,
                                    RightsPredicate check, QWidget *parent = nullptr);
    //! Destroys the widget.
    ~SupplementElementsElementWidget() override;
};

#endif // KVT_SUPPLEMENTELEMENTSELEMENTWIDGET_H
