// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "configlines_p.h"

#include "regexphandler.h"
#include "regexpprefilter_p.h"

#include <QIODevice>
#include <QTextCodec>

#include <cstring>

namespace {

const int outputBlockSize = 1 << 20;

// Lines are read in large blocks rather than one readLine() at a time: a
// rewrite of a big file spends most of its time there otherwise. A line is
// what readLine() would give: everything up to and including the next '\n',
// or the rest of the file.
class LineReader
{
public:
    explicit LineReader(QIODevice &file)
        : _file(file)
    {
    }

    // Points \a data and \a size at the next line; false at end of file (or
    // on a read error, which the file then reports).
    bool next(const char *&data, int &size)
    {
        for (;;) {
            const int available = _buffer.size() - _position;
            const char *start = _buffer.constData() + _position;
            if (available > 0 && _searched < available) {
                const void *newline = std::memchr(start + _searched, '\n', size_t(available - _searched));
                if (newline) {
                    data = start;
                    size = int(static_cast<const char *>(newline) - start) + 1;
                    _position += size;
                    _searched = 0;
                    return true;
                }
                _searched = available;
            }
            if (_atEnd) {
                if (available == 0)
                    return false;
                data = start;
                size = available;
                _position = _buffer.size();
                _searched = 0;
                return true;
            }
            fill();
        }
    }

private:
    void fill()
    {
        // Keep the unfinished line, then append the next block after it.
        if (_position > 0) {
            _buffer.remove(0, _position);
            _position = 0;
        }
        // No more than the file still holds: a small file is not given a
        // block of a megabyte.
        const qint64 left = _file.isSequential() ? blockSize : _file.size() - _file.pos();
        const int wanted = int(qBound<qint64>(1, left, blockSize));
        const int kept = _buffer.size();
        _buffer.resize(kept + wanted);
        const qint64 got = _file.read(_buffer.data() + kept, wanted);
        _buffer.resize(kept + int(qMax<qint64>(got, 0)));
        if (got <= 0)
            _atEnd = true;
    }

    static const int blockSize = 1 << 20;
    QIODevice &_file;
    QByteArray _buffer;
    int _position = 0;
    int _searched = 0; // bytes after _position known to hold no '\n'
    bool _atEnd = false;
};

bool isAsciiSpace(char c)
{
    return c == ' ' || (c >= '\t' && c <= '\r');
}

// True when every character the locale codec produces from an ASCII byte is
// that byte, whatever surrounds it; then the text before a comment can be
// found in the raw bytes without decoding the whole line.
bool localeKeepsAscii()
{
    const QTextCodec *codec = QTextCodec::codecForLocale();
    if (!codec)
        return false;
    switch (codec->mibEnum()) {
    case 3:   // US-ASCII
    case 4:   // ISO-8859-1
    case 106: // UTF-8
    case 111: // ISO-8859-15
        return true;
    default:
        return false;
    }
}

// Line selection shared by both traversals: whether the line is a candidate
// (the text before its first '#', trimmed, is not empty) and the handler's
// expression is found in that text. No quoting is understood: a '#' inside a
// quoted value starts the comment all the same.
bool lineMatches(RegExpHandler &handler, RegExpPrefilter &prefilter, const char *data, int size,
                 bool asciiShortcut)
{
    // The decoded line stops at the first NUL byte.
    if (const void *nul = std::memchr(data, '\0', size_t(size)))
        size = int(static_cast<const char *>(nul) - data);

    if (asciiShortcut) {
        const void *hash = std::memchr(data, '#', size_t(size));
        const int end = hash ? int(static_cast<const char *>(hash) - data) : size;
        bool ascii = true;
        for (int i = 0; i < end && ascii; ++i)
            ascii = static_cast<unsigned char>(data[i]) < 0x80;
        if (ascii) {
            int first = 0;
            int last = end;
            while (first < last && isAsciiSpace(data[first]))
                ++first;
            while (last > first && isAsciiSpace(data[last - 1]))
                --last;
            if (first == last)
                return false;
            if (prefilter.usable(handler.regExp()) && !prefilter.canMatch(data + first, last - first))
                return false;
            return handler.regExp().indexIn(QString::fromLatin1(data + first, last - first), 0) != -1;
        }
    }

    const QString decoded = QString::fromLocal8Bit(data, size);
    const int commentStart = decoded.indexOf(QLatin1Char('#'));
    const QString text = (commentStart < 0 ? decoded : decoded.left(commentStart)).trimmed();
    if (text.isEmpty())
        return false;
    return handler.regExp().indexIn(text, 0) != -1;
}

} // namespace

namespace KvtConfigLines {

void readLines(QIODevice &in, RegExpHandler &handler)
{
    const bool asciiShortcut = localeKeepsAscii();
    RegExpPrefilter prefilter;
    LineReader reader(in);
    const char *data = nullptr;
    int size = 0;
    while (reader.next(data, size)) {
        if (lineMatches(handler, prefilter, data, size, asciiShortcut))
            handler.handleRegExp(nullptr);
    }
}

bool rewriteLines(QIODevice &in, RegExpHandler &handler, const std::function<bool(const QByteArray &)> &write)
{
    // The new content is gathered in memory and written in large blocks.
    QByteArray buffer;
    const auto flush = [&](int threshold) {
        if (buffer.size() < threshold)
            return true;
        const bool written = write(buffer);
        buffer.clear();
        return written;
    };
    const bool asciiShortcut = localeKeepsAscii();
    RegExpPrefilter prefilter;
    LineReader reader(in);
    const char *data = nullptr;
    int size = 0;
    while (reader.next(data, size)) {
        if (!lineMatches(handler, prefilter, data, size, asciiShortcut)) {
            buffer.append(data, size);
            if (!flush(outputBlockSize))
                return false;
            continue;
        }
        QByteArray raw(data, size);
        const bool replaced = handler.handleRegExp(&raw);
        buffer.append(raw);
        if (replaced) {
            // The handler gave bare content: put the line's comment back and
            // end the line.
            // Decoded as a line is everywhere: up to its first NUL byte.
            const QString decoded = QString::fromLocal8Bit(QByteArray::fromRawData(data, size));
            const int commentStart = decoded.indexOf(QLatin1Char('#'));
            if (commentStart >= 0) {
                const QString comment = decoded.mid(commentStart).trimmed();
                if (!comment.isEmpty()) {
                    buffer.append('\t');
                    buffer.append(comment.toLocal8Bit());
                }
            }
            buffer.append('\n');
        }
        if (!flush(outputBlockSize))
            return false;
    }

    QByteArray tail;
    if (handler.finalHandleRegExp(&tail))
        buffer.append(tail);
    return flush(0);
}

} // namespace KvtConfigLines
