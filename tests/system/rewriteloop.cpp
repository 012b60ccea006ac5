// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Rewrites the file given as its argument over and over, each time turning
// every "= a" into "= b" and back, until it is killed. Used by the kill test
// of the configuration rewrite; it leads a process group of its own so that
// the test can kill it together with the cp it runs.

#include <kvt-common/regexphandler.h>

#include <QCoreApplication>

#include <cstdio>
#include <unistd.h>

namespace {

struct FlipHandler : RegExpHandler {
    FlipHandler()
        : RegExpHandler(QStringLiteral("^(\\w+) = ([ab])$"))
    {
    }
    bool handleRegExp(QByteArray *line) override
    {
        *line = regExp().cap(1).toLatin1() + (regExp().cap(2) == QLatin1String("a") ? " = b" : " = a");
        return true;
    }
};

} // namespace

int main(int argc, char **argv)
{
    QCoreApplication app(argc, argv);
    if (argc != 2)
        return 2;
    ::setpgid(0, 0);
    const QString file = QString::fromLocal8Bit(argv[1]);
    for (;;) {
        FlipHandler handler;
        QString error;
        if (!RegExpHandler::rewriteSystemConfigureFile(file, handler, error, false)) {
            std::fprintf(stderr, "%s\n", qPrintable(error));
            return 1;
        }
    }
}
