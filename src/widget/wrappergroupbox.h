// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_WRAPPERGROUPBOX_H
#define KVT_WRAPPERGROUPBOX_H

#include "kvtcommon_export.h"

#include <QGroupBox>

/*!
 * The frame in which ElementWidgetContainer2 shows a single element
 * widget. It holds at most one widget and never owns it: a removed widget,
 * and the widget still held when the frame is destroyed, is taken out of
 * the frame (left without parent) rather than deleted.
 */
class KVTCOMMON_EXPORT WrapperGroupBox : public QGroupBox
{
    Q_OBJECT

public:
    //! Creates the empty frame.
    explicit WrapperGroupBox(QWidget *parent = nullptr);
    //! Destroys the frame; a widget still held is taken out first, not deleted.
    ~WrapperGroupBox() override;

    /*! Removes the widget held so far and shows \a widget instead; a null
     *  \a widget only removes. */
    void insertWidget(QWidget *widget);
    /*! Takes the widget held out of the frame, without deleting it. */
    void removeWidget();
    /*! The widget held, or null. */
    QWidget *widget() const;
};

#endif // KVT_WRAPPERGROUPBOX_H
