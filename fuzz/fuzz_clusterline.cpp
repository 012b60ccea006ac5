// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// One line of pg_lsclusters output: parsed, or refused with the library's
// exception. The fields of a parsed line are never empty and never begin or
// end with white space.

#include "appexception.h"
#include "pgsqlcluster.h"

#include <QString>

#include <cstdint>
#include <cstdlib>
#include <memory>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size)
{
    const QString line = QString::fromUtf8(reinterpret_cast<const char *>(data), int(size));
    std::unique_ptr<PgsqlCluster> cluster;
    try {
        cluster.reset(PgsqlCluster::fromString(line));
    } catch (const AppException &e) {
        if (!e.getText().startsWith(QLatin1String("Cluster info not valid '")))
            std::abort();
        return 0;
    }
    const QStringList fields{cluster->version(), cluster->name(), QString::number(cluster->port()), cluster->status(),
                             cluster->owner(), cluster->dataDirectory(), cluster->logFile()};
    for (const QString &field : fields) {
        if (field.isEmpty() || field != field.trimmed())
            std::abort();
    }
    // The port is all digits; a number too large for an int reads as 0.
    if (cluster->port() < 0)
        std::abort();
    return 0;
}
