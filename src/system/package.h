// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PACKAGE_H
#define KVT_PACKAGE_H

#include "kvtcommon_export.h"

#include <QObject>
#include <QString>

/*!
 * A Debian binary package, asked about through dpkg-query.
 *
 * The name is handed to dpkg-query as it is, so a pattern such as
 * "postgresql-[0123456789]*" asks whether any matching package is installed.
 */
class KVTCOMMON_EXPORT Package : public QObject
{
    Q_OBJECT

public:
    //! Creates the query of the package (or package pattern) \a name; nothing runs yet.
    explicit Package(const QString &name);
    ~Package() override;

    //! The package name or pattern.
    QString name() const { return _name; }

    /*!
     * True when the status of the package (or of one package matching the
     * pattern) starts with "install ok". Runs dpkg-query on every call; throws
     * AppException when it cannot be run or does not end within 30 seconds.
     */
    bool isInstalled() const;

private:
    QString _name;
};

#endif
