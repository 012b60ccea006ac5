// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ADMIN_SERVICEWIDGET_H
#define KVT_ADMIN_SERVICEWIDGET_H

#include <kvt-common/vieweditelementwidget.h>

class QLabel;
class QPlainTextEdit;
class ServicesModule;

/*!
 * Shows one service: its state, the buttons of the module's element actions
 * (Start, Stop, Restart, Reload) and the output of its status command. There
 * is nothing to edit and apply: the actions act at once, through tasks.
 */
class ServiceWidget : public ViewEditElementWidget
{
    Q_OBJECT

public:
    explicit ServiceWidget(ServicesModule &module, QWidget *parent = nullptr);

    void setElement(Element *element, ElementWidgetRole role) override;
    void afterSuccessfulRead(Element *element, ElementData *data) override;
    void blockEditWidget(bool block) override;
    QString toolTipText() const override;

    QString statusText() const;
    QString stateText() const;

private:
    void showState();

    ServicesModule &_servicesModule;
    QLabel *_stateLabel;
    QPlainTextEdit *_statusPlainTextEdit;
};

#endif // KVT_ADMIN_SERVICEWIDGET_H
