// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_STRINGSPLIT_P_H
#define KVT_STRINGSPLIT_P_H

#include <QString>
#include <QStringList>

// Splitting with empty parts skipped, spelled for every Qt 5 the library
// builds against without deprecation warnings.
inline QStringList splitSkippingEmpty(const QString &text, QChar separator)
{
#if QT_VERSION >= QT_VERSION_CHECK(5, 14, 0)
    return text.split(separator, Qt::SkipEmptyParts, Qt::CaseSensitive);
#else
    return text.split(separator, QString::SkipEmptyParts, Qt::CaseSensitive);
#endif
}

#endif
