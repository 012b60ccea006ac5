// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "pgsqlcluster.h"

#include "appexception.h"
#include "pgsql_p.h"
#include "process.h"
#include "stringsplit_p.h"

#include <QRegularExpression>

namespace {

// Both expressions are built once, when the library is loaded.
const QRegularExpression clusterLineExpression(QStringLiteral(
    "^(?P<version>.+)\\s+(?P<name>.+)\\s+(?P<port>\\d+)\\s+(?P<status>.+)\\s+(?P<owner>.+)"
    "\\s+(?P<dataDirectory>.+)\\s+(?P<logFile>.+)$"));

const QRegularExpression userListExpression(
    QStringLiteral("\\s*usename\\s*-+\\s*(?P<users>.*?)\\s*\\((?P<count>\\d+)\\s+rows?\\)\\s*"),
    QRegularExpression::DotMatchesEverythingOption);

// Unquoted identifiers are folded to lower case by the server, so only
// lower-case ones come back from the user list as they were written. "\\z"
// and not "$": the latter also matches before a final newline.
const QRegularExpression plainIdentifier(QStringLiteral("\\A[a-z_][a-z0-9_]{0,62}\\z"));

// Characters that keep their meaning inside the double quotes of the su
// command line, or end it.
bool leavesShellQuotes(const QString &text)
{
    for (const QChar c : text) {
        switch (c.unicode()) {
        case '"':
        case '\\':
        case '$':
        case '`':
        case '\n':
        case '\r':
        case 0:
            return true;
        default:
            break;
        }
    }
    return false;
}

} // namespace

bool KvtPgsql::parseUserList(const QString &output, QStringList *users)
{
    const QRegularExpressionMatch match = userListExpression.match(output);
    if (!match.hasMatch())
        return false;
    // The row count in the footer is not checked against the names.
    *users = splitSkippingEmpty(match.captured(QStringLiteral("users")), QLatin1Char('\n'));
    for (QString &name : *users)
        name = name.trimmed();
    return true;
}

PgsqlCluster::PgsqlCluster(QObject *parent)
    : QObject(parent)
    , _port(0)
{
}

PgsqlCluster::~PgsqlCluster() = default;

PgsqlCluster *PgsqlCluster::fromString(const QString &line)
{
    // The groups are greedy, so runs of blanks between columns would end up
    // inside the earlier fields; with single blanks a line of seven fields
    // maps field for field. Surplus fields still go to the earliest groups.
    const QRegularExpressionMatch match = clusterLineExpression.match(line.simplified());
    if (!match.hasMatch())
        throw AppException(tr("Cluster info not valid '%1'").arg(line));

    auto *cluster = new PgsqlCluster;
    cluster->_version = match.captured(QStringLiteral("version"));
    cluster->_name = match.captured(QStringLiteral("name"));
    cluster->_port = match.captured(QStringLiteral("port")).toInt(nullptr, 10);
    cluster->_status = match.captured(QStringLiteral("status"));
    cluster->_owner = match.captured(QStringLiteral("owner"));
    cluster->_dataDirectory = match.captured(QStringLiteral("dataDirectory"));
    cluster->_logFile = match.captured(QStringLiteral("logFile"));
    return cluster;
}

bool PgsqlCluster::isWork() const
{
    Process process;
    process.simpleStart(QLatin1String(KvtPgsql::clusterControlProgram),
                        {_version, _name, QStringLiteral("status")}, false);
    return process.exitCode() == 0;
}

void PgsqlCluster::start() const
{
    Process process;
    process.simpleStart(QLatin1String(KvtPgsql::clusterControlProgram),
                        {_version, _name, QStringLiteral("start")}, true);
}

QString PgsqlCluster::sqlRequest(const QString &query) const
{
    // The query is put between double quotes of a shell command line as it
    // is; whatever could end the quotes or be expanded inside them is
    // refused before anything runs.
    if (leavesShellQuotes(query))
        throw AppException(tr("SQL request '%1' contains a character that cannot be passed to the shell").arg(query));

    const QString command = QStringLiteral("psql -p %1 -c \"%2\"").arg(QString::number(_port), query);
    Process process;
    process.simpleStart(QStringLiteral("su"), {QStringLiteral("postgres"), QStringLiteral("-c"), command}, true);
    return process.output();
}

QStringList PgsqlCluster::usernames() const
{
    const QString query = QLatin1String(KvtPgsql::userListQuery);
    QStringList names;
    if (!KvtPgsql::parseUserList(sqlRequest(query), &names))
        throw AppException(tr("SQL request '%1' not mathed").arg(query));
    return names;
}

void PgsqlCluster::createUser(const QString &name) const
{
    if (!plainIdentifier.match(name).hasMatch())
        throw AppException(tr("User name '%1' is not a plain SQL identifier").arg(name));
    if (usernames().contains(name))
        return;
    sqlRequest(QStringLiteral("create user %1;").arg(name));
}

void PgsqlCluster::deleteUser(const QString &name) const
{
    if (!plainIdentifier.match(name).hasMatch())
        throw AppException(tr("User name '%1' is not a plain SQL identifier").arg(name));
    if (!usernames().contains(name))
        return;
    sqlRequest(QStringLiteral("drop user %1;").arg(name));
}
