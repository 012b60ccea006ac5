#include "regexphandler.h"

#include "regexpprefilter_p.h"

#include <QFile>
#include <QObject>
#include <QProcess>
#include <QStringList>
#include <QTextCodec>

#include <cstring>

namespace {

const int copyTimeoutMs = 30000;
const int outputBlockSize = 1 << 20;

void appendError(QString &error, const QString &message)
{
    if (!error.isEmpty())
        error += QLatin1Char('\n');
    error += message;
}

void appendNotExists(QString &error, const QString &fileName)
{
    appendError(error, QObject::tr("\"%1\" not exists").arg(fileName));
}

void appendFileError(QString &error, const QFileDevice &file)
{
    appendError(error, QObject::tr("\"%1\" error %2\n%3")
                           .arg(file.fileName(), QString::number(int(file.error())), file.errorString()));
}

// Lines are read in large blocks rather than one readLine() at a time: a
// rewrite of a big file spends most of its time there otherwise. A line is
// what readLine() would give: everything up to and including the next '\n',
// or the rest of the file.
class LineReader
{
public:
    explicit LineReader(QFile &file)
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
        const int kept = _buffer.size();
        _buffer.resize(kept + blockSize);
        const qint64 got = _file.read(_buffer.data() + kept, blockSize);
        _buffer.resize(kept + int(qMax<qint64>(got, 0)));
        if (got <= 0)
            _atEnd = true;
    }

    static const int blockSize = 1 << 20;
    QFile &_file;
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

RegExpHandler::RegExpHandler(const QString &pattern)
    : _regExp(pattern, Qt::CaseSensitive, QRegExp::RegExp)
{
}

RegExpHandler::~RegExpHandler() = default;

bool RegExpHandler::finalHandleRegExp(QByteArray *tail)
{
    Q_UNUSED(tail)
    return false;
}

bool RegExpHandler::readSystemConfigureFile(const QString &fileName, RegExpHandler &handler, QString &error)
{
    if (!QFile::exists(fileName)) {
        appendNotExists(error, fileName);
        return false;
    }
    QFile file(fileName);
    if (!file.open(QIODevice::ReadOnly)) {
        appendFileError(error, file);
        return false;
    }
    const bool asciiShortcut = localeKeepsAscii();
    RegExpPrefilter prefilter;
    LineReader reader(file);
    const char *data = nullptr;
    int size = 0;
    while (reader.next(data, size)) {
        if (lineMatches(handler, prefilter, data, size, asciiShortcut))
            handler.handleRegExp(nullptr);
    }
    file.close();
    return true;
}

bool RegExpHandler::rewriteSystemConfigureFile(const QString &fileName, RegExpHandler &handler, QString &error,
                                               bool backup)
{
    if (!QFile::exists(fileName)) {
        appendNotExists(error, fileName);
        return false;
    }

    // The work copy starts as a cp of the file, so it already has the file's
    // mode and owner; a stale one from an earlier failure is overwritten.
    const QString workName = QStringLiteral("%1.tmp").arg(fileName);
    if (!safeCopy(fileName, workName, error))
        return false;

    QFile target(fileName);
    if (!target.open(QIODevice::ReadOnly)) {
        appendFileError(error, target);
        return false;
    }
    QFile work(workName);
    if (!work.open(QIODevice::WriteOnly)) {
        target.close();
        appendFileError(error, work);
        return false;
    }

    // The new content is gathered in memory and written in large blocks.
    QByteArray out;
    const auto flush = [&](int threshold) {
        if (out.size() >= threshold) {
            work.write(out);
            out.clear();
        }
    };
    const bool asciiShortcut = localeKeepsAscii();
    RegExpPrefilter prefilter;
    LineReader reader(target);
    const char *data = nullptr;
    int size = 0;
    while (reader.next(data, size)) {
        if (!lineMatches(handler, prefilter, data, size, asciiShortcut)) {
            out.append(data, size);
            flush(outputBlockSize);
            continue;
        }
        QByteArray raw(data, size);
        const bool replaced = handler.handleRegExp(&raw);
        out.append(raw);
        if (replaced) {
            // The handler gave bare content: put the line's comment back and
            // end the line.
            // Decoded as a line is everywhere: up to its first NUL byte.
            const QString decoded = QString::fromLocal8Bit(QByteArray::fromRawData(data, size));
            const int commentStart = decoded.indexOf(QLatin1Char('#'));
            if (commentStart >= 0) {
                const QString comment = decoded.mid(commentStart).trimmed();
                if (!comment.isEmpty()) {
                    out.append('\t');
                    out.append(comment.toLocal8Bit());
                }
            }
            out.append('\n');
        }
        flush(outputBlockSize);
    }

    QByteArray tail;
    if (handler.finalHandleRegExp(&tail))
        out.append(tail);
    flush(0);

    // A work copy that could not be written completely (a full disk) must
    // never be copied over the file.
    const bool readFailed = target.error() != QFileDevice::NoError;
    work.close();
    const bool writeFailed = work.error() != QFileDevice::NoError;
    target.close();
    if (writeFailed) {
        appendFileError(error, work);
        return false;
    }
    if (readFailed) {
        appendFileError(error, target);
        return false;
    }

    if (backup) {
        const QString backupName = QStringLiteral("%1.bak").arg(fileName);
        if (QFile::exists(backupName))
            QFile::remove(backupName);
        if (!target.copy(backupName)) {
            appendFileError(error, target);
            return false;
        }
    }

    if (!safeCopy(workName, fileName, error))
        return false;

    if (!work.remove()) {
        // The file already has its new content; only the clean-up failed.
        appendFileError(error, work);
        return false;
    }
    return true;
}

bool RegExpHandler::safeCopy(const QString &source, const QString &destination, QString &error)
{
    const QString program = QStringLiteral("cp");
    const QStringList arguments{QStringLiteral("--force"), QStringLiteral("--preserve=mode,ownership"), source,
                                destination};
    const QString joined = arguments.join(QLatin1Char(' '));

    // No shell: the paths reach cp exactly as given.
    QProcess process;
    process.start(program, arguments, QIODevice::ReadOnly);
    if (!process.waitForStarted(copyTimeoutMs)) {
        appendError(error, QObject::tr("Process: \"%1 %2\". Error: %3.\n\"Not started\"")
                               .arg(program, joined, process.errorString()));
        return false;
    }
    if (!process.waitForFinished(copyTimeoutMs) || process.exitStatus() == QProcess::CrashExit) {
        appendError(error, QObject::tr("Process: \"%1 %2\". Error: %3.\n\"Not finished\"")
                               .arg(program, joined, process.errorString()));
        return false;
    }
    if (process.exitCode() != 0) {
        const QString errorText = QString::fromLocal8Bit(process.readAllStandardError()).trimmed();
        appendError(error, QObject::tr("Process: \"%1 %2\". Exit code: %3.\n\"%4\"")
                               .arg(program, joined, QString::number(process.exitCode()), errorText));
        return false;
    }
    return true;
}
