// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ADMIN_POSTGRESQLWIDGETS_H
#define KVT_ADMIN_POSTGRESQLWIDGETS_H

#include <kvt-common/vieweditelementwidget.h>

class PostgresqlModule;
class QFormLayout;
class QLabel;

/*!
 * Shows the fields of an element's record as read-only lines, with the
 * buttons of the module's element actions for the element type. The record
 * is already in the element, so read() needs no task.
 */
class PgsqlInfoWidget : public ViewEditElementWidget
{
    Q_OBJECT

public:
    PgsqlInfoWidget(PostgresqlModule &module, const QString &type,
                    const QList<QPair<QString, QString>> &fields, QWidget *parent = nullptr);

    void setElement(Element *element, ElementWidgetRole role) override;
    void read() override;
    void afterSuccessfulRead(Element *element, ElementData *data) override;
    void blockEditWidget(bool block) override;
    QString toolTipText() const override;

    /*! The text shown for the record key \a key. */
    QString fieldText(const QString &key) const;

private Q_SLOTS:
    void refresh();

private:
    PostgresqlModule &_pgsqlModule;
    QList<QPair<QString, QLabel *>> _fields;
};

class ClusterWidget : public PgsqlInfoWidget
{
    Q_OBJECT

public:
    explicit ClusterWidget(PostgresqlModule &module, QWidget *parent = nullptr);
};

class PgUserWidget : public PgsqlInfoWidget
{
    Q_OBJECT

public:
    explicit PgUserWidget(PostgresqlModule &module, QWidget *parent = nullptr);
};

/*!
 * Creates a database user in the cluster it is shown for. Name and password
 * are asked with the library's credential dialog, which opens as soon as
 * the widget is shown for creating; applying starts the task.
 */
class PgUserCreateWidget : public ViewEditElementWidget
{
    Q_OBJECT

public:
    explicit PgUserCreateWidget(PostgresqlModule &module, QWidget *parent = nullptr);

    void beforeCreation() override;
    ElementData *exportElementData() const override;
    bool isContentValid() const override;
    QString toolTipText() const override;
    QString caption() const override;

    QString userName() const { return _user; }

public Q_SLOTS:
    /*! Asks for the name and password of the new user. */
    void askCredentials();

private:
    PostgresqlModule &_pgsqlModule;
    QLabel *_clusterLabel;
    QLabel *_userLabel;
    QString _user;
    QString _password;
};

#endif // KVT_ADMIN_POSTGRESQLWIDGETS_H
