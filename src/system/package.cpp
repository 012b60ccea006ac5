// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "package.h"

#include "process.h"
#include "stringsplit_p.h"

#include <QRegularExpression>

Package::Package(const QString &name)
    : QObject(nullptr)
    , _name(name)
{
}

Package::~Package() = default;

bool Package::isInstalled() const
{
    Process process;
    // The exit code is ignored on purpose: for an unknown package dpkg-query
    // fails with empty output, which reads as "not installed".
    process.simpleStart(QStringLiteral("dpkg-query"),
                        {QStringLiteral("-W"), QStringLiteral("-f=${Status}\n"), _name},
                        false);

    // Only the wanted state and the error flag are looked at, so "install ok
    // unpacked" and "install ok half-configured" count as installed too.
    static const QRegularExpression installed(QStringLiteral("^install ok"));
    const QStringList lines = splitSkippingEmpty(process.output(), QLatin1Char('\n'));
    for (const QString &line : lines) {
        if (installed.match(line).hasMatch())
            return true;
    }
    return false;
}
