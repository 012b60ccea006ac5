#ifndef KVT_PGSQL_P_H
#define KVT_PGSQL_P_H

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

} // namespace KvtPgsql

#endif
