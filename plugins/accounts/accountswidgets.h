// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ADMIN_ACCOUNTSWIDGETS_H
#define KVT_ADMIN_ACCOUNTSWIDGETS_H

#include <kvt-common/vieweditelementwidget.h>

#include <QMap>

class AccountsModule;
class ChoiceTreeNodeProxyModel;
class ChoiceWidget;
class QLabel;
class QPushButton;
class TreeNodeModel;

/*!
 * One user: login, UID, primary group, home, shell, the GECOS sub-fields and
 * the groups the user belongs to. An administrator changes the GECOS field
 * and the password through the library's dialogs (applied at once, each by
 * a task) and the groups through the choice widget (applied with Apply).
 */
class UserWidget : public ViewEditElementWidget
{
    Q_OBJECT

public:
    explicit UserWidget(AccountsModule &module, QWidget *parent = nullptr);

    void setElement(Element *element, ElementWidgetRole role) override;
    ElementData *exportElementData() const override;
    void afterSuccessfulRead(Element *element, ElementData *data) override;
    void blockEditWidget(bool block) override;
    QString toolTipText() const override;

    /*! The text shown for \a key: "user", "uid", "primaryGroup", "home",
     *  "shell", "fullName", "room", "phone", "other" or "groups". */
    QString fieldText(const QString &key) const;
    ChoiceWidget *choiceWidget() const { return _groupsChoiceWidget; }

public Q_SLOTS:
    void changeGecos();
    void changePassword();

private Q_SLOTS:
    void choiceChanged();

private:
    AccountsModule &_accountsModule;
    QMap<QString, QLabel *> _labels;
    QString _gecos;
    ChoiceWidget *_groupsChoiceWidget;
    TreeNodeModel *_groupModel;
    ChoiceTreeNodeProxyModel *_choiceModel;
    QPushButton *_gecosPushButton;
    QPushButton *_passwordPushButton;
    QPushButton *_applyPushButton;
    bool _filling = false;
};

/*! One group: name, GID and members. */
class GroupWidget : public ViewEditElementWidget
{
    Q_OBJECT

public:
    explicit GroupWidget(AccountsModule &module, QWidget *parent = nullptr);

    void afterSuccessfulRead(Element *element, ElementData *data) override;
    void blockEditWidget(bool block) override;
    QString toolTipText() const override;
    QString fieldText(const QString &key) const;

private:
    QMap<QString, QLabel *> _labels;
};

#endif // KVT_ADMIN_ACCOUNTSWIDGETS_H
