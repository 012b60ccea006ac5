// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// The floor of `kvt-admin --list`: a bare program that starts, reads the
// same files the same way (the library's read plus the line pass of the
// configuration files plugin) and prints their keys. No window, no plugin,
// no task.
#include "conffileformat.h"

#include <QCoreApplication>
#include <QFileInfo>
#include <QTextStream>

int main(int argc, char **argv)
{
    QCoreApplication app(argc, argv);
    QTextStream out(stdout);
    int result = 0;
    for (const QString &path : app.arguments().mid(1)) {
        ConfFileScan scan;
        QString error;
        out << QFileInfo(path).fileName() << '\n';
        if (!ConfFileFormat::scan(path, scan, error)) {
            out << "  " << error << '\n';
            result = 1;
            continue;
        }
        for (const ConfEntry &entry : qAsConst(scan.entries))
            out << "    " << entry.key << " = " << entry.value << '\n';
    }
    return result;
}
