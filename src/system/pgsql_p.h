// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PGSQL_P_H
#define KVT_PGSQL_P_H

#include <QStringList>

// Fixed texts of the PostgreSQL helpers.
namespace KvtPgsql {

// dpkg-query expands the pattern, so any versioned server package counts.
inline constexpr char serverPackagePattern[] = "postgresql-[0123456789]*";
inline constexpr char clusterListProgram[] = "pg_lsclusters";
inline constexpr char clusterControlProgram[] = "pg_ctlcluster";
inline constexpr char userListQuery[] = "SELECT u.usename FROM pg_catalog.pg_user u;";
// Part of the published set of names; the cluster classes themselves control
// clusters through pg_ctlcluster only.
inline constexpr char serviceControlProgram[] = "/bin/systemctl";
inline constexpr char serviceUnitName[] = "postgresql";

// The user names in psql's output of the user list query: the lines between
// the dashed header rule and the row-count footer, trimmed, empty ones
// skipped. False when the output has no such header and footer.
bool parseUserList(const QString &output, QStringList *users);

} // namespace KvtPgsql

#endif
