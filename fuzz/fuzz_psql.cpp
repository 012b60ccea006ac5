// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// psql's output of the user list query: the names found are trimmed single
// lines (a line of blanks between the rules gives an empty name, as the split
// before the trim has it).

#include "pgsql_p.h"

#include <QString>

#include <cstdint>
#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size)
{
    const QString output = QString::fromUtf8(reinterpret_cast<const char *>(data), int(size));
    QStringList users;
    if (!KvtPgsql::parseUserList(output, &users))
        return 0;
    if (!output.contains(QLatin1String("usename")))
        std::abort();
    for (const QString &name : qAsConst(users)) {
        if (name != name.trimmed() || name.contains(QLatin1Char('\n')))
            std::abort();
    }
    return 0;
}
