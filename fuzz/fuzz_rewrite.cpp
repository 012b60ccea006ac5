// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// The line handling of the configuration rewrite and read against a literal
// reading of their rules: lines read one by one with readLine(), decoded,
// cut at the first "#", trimmed and searched with QRegExp.
//
// Input: the first line is the expression (up to 32 bytes), the rest the
// file. The handler's decision for a matching line depends on the match, so
// replaced, deleted and kept lines all occur.

#include "configlines_p.h"
#include "regexphandler.h"

#include <QBuffer>

#include <cstdint>
#include <cstdlib>

namespace {

struct DecidingHandler : RegExpHandler {
    using RegExpHandler::RegExpHandler;
    bool handleRegExp(QByteArray *line) override
    {
        ++matches;
        if (!line)
            return false;
        const QString match = regExp().cap(0);
        switch (match.size() % 3) {
        case 0: // replaced by bare content; the comment comes back
            *line = "R" + match.toLocal8Bit();
            return true;
        case 1: // deleted
            line->clear();
            return false;
        default: // kept as it is
            return false;
        }
    }
    bool finalHandleRegExp(QByteArray *tail) override
    {
        *tail = "tail = 1\n";
        return true;
    }
    int matches = 0;
};

QByteArray literalRewrite(const QByteArray &content, DecidingHandler &handler)
{
    QBuffer in;
    in.setData(content);
    in.open(QIODevice::ReadOnly);
    QByteArray out;
    while (!in.atEnd()) {
        QByteArray raw = in.readLine();
        const QString decoded = QString::fromLocal8Bit(raw);
        const int commentStart = decoded.indexOf(QLatin1Char('#'));
        const QString text = (commentStart < 0 ? decoded : decoded.left(commentStart)).trimmed();
        if (text.isEmpty() || handler.regExp().indexIn(text, 0) == -1) {
            out += raw;
            continue;
        }
        const bool replaced = handler.handleRegExp(&raw);
        out += raw;
        if (replaced) {
            const QString comment = commentStart < 0 ? QString() : decoded.mid(commentStart).trimmed();
            if (!comment.isEmpty())
                out += '\t' + comment.toLocal8Bit();
            out += '\n';
        }
    }
    QByteArray tail;
    if (handler.finalHandleRegExp(&tail))
        out += tail;
    return out;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, size_t size)
{
    const QByteArray input = QByteArray::fromRawData(reinterpret_cast<const char *>(data), int(size));
    const int newline = input.indexOf('\n');
    if (newline < 0 || newline > 32)
        return 0;
    const QString pattern = QString::fromLatin1(input.left(newline));
    const QByteArray content = input.mid(newline + 1);

    DecidingHandler literal(pattern);
    const QByteArray expected = literalRewrite(content, literal);

    DecidingHandler handler(pattern);
    QBuffer in;
    in.setData(content);
    in.open(QIODevice::ReadOnly);
    QByteArray out;
    KvtConfigLines::rewriteLines(in, handler, [&out](const QByteArray &block) { return out += block, true; });
    if (out != expected || handler.matches != literal.matches)
        std::abort();

    DecidingHandler reader(pattern);
    in.seek(0);
    KvtConfigLines::readLines(in, reader);
    if (reader.matches != literal.matches)
        std::abort();
    return 0;
}
