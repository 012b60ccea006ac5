// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#include "conffileformat.h"

#include <QFile>
#include <QHash>
#include <QMap>
#include <QRegExp>

namespace ConfFileFormat {

namespace {

QString tr(const char *text)
{
    return QCoreApplication::translate("ConfFileFormat", text);
}

// Collects the key lines the library reports, in file order.
class KeyCollector : public RegExpHandler
{
public:
    KeyCollector() : RegExpHandler(keyLinesPattern()) {}
    bool handleRegExp(QByteArray *) override
    {
        ConfEntry entry;
        entry.key = regExp().cap(1);
        entry.separator = regExp().cap(2);
        entry.value = regExp().cap(3);
        entries.append(entry);
        return false;
    }
    QVector<ConfEntry> entries;
};

QByteArray lineEndOf(const QByteArray &raw)
{
    if (raw.endsWith("\r\n"))
        return QByteArrayLiteral("\r\n");
    if (raw.endsWith('\n'))
        return QByteArrayLiteral("\n");
    return QByteArray();
}

} // namespace

QString keyLinesPattern()
{
    // Matched against the text before the first "#", trimmed (the library's
    // rule): a key, then "=", blanks or nothing, then the value.
    return QStringLiteral("^([^\\s=]+)(\\s*=\\s*|\\s+|$)(.*)$");
}

QString keyLinePattern(const QString &key)
{
    return QStringLiteral("^%1(\\s*=|\\s|$)").arg(QRegExp::escape(key));
}

QString keyProblem(const QString &key)
{
    if (key.isEmpty())
        return tr("The key is empty.");
    for (const QChar c : key) {
        if (c.isSpace() || c == QLatin1Char('=') || c == QLatin1Char('#'))
            return tr("A key holds no blank, \"=\" or \"#\".");
    }
    return QString();
}

QString valueProblem(const QString &value)
{
    // Everything after "#" is a comment to every reader of these files: a
    // value with "#" would be cut there when read back.
    if (value.contains(QLatin1Char('#')))
        return tr("A value cannot hold \"#\": it would start a comment.");
    if (value.contains(QLatin1Char('\n')) || value.contains(QLatin1Char('\r')))
        return tr("A value is one line.");
    if (value.size() > MaxEditableValue)
        return tr("The value is longer than %1 characters.").arg(MaxEditableValue);
    return QString();
}

QString commentProblem(const QString &comment)
{
    if (comment.contains(QLatin1Char('\n')) || comment.contains(QLatin1Char('\r')))
        return tr("A comment is one line.");
    return QString();
}

bool scan(const QString &fileName, ConfFileScan &result, QString &error)
{
    KeyCollector collector;
    if (!RegExpHandler::readSystemConfigureFile(fileName, collector, error))
        return false;

    QFile file(fileName);
    if (!file.open(QIODevice::ReadOnly)) {
        if (!error.isEmpty())
            error += QLatin1Char('\n');
        error += tr("\"%1\" error %2\n%3").arg(fileName).arg(int(file.error())).arg(file.errorString());
        return false;
    }
    QRegExp keyLine(keyLinesPattern());
    QHash<QString, int> seen;
    QHash<QString, int> firstLine;
    QMap<QString, QList<int>> duplicates;
    int index = 0;
    int lineNumber = 0;
    QByteArray raw;
    while (!file.atEnd()) {
        raw = file.readLine();
        ++lineNumber;
        if (lineNumber == 1 && raw.endsWith("\r\n"))
            result.lineEnd = QByteArrayLiteral("\r\n");
        const QString decoded = QString::fromLocal8Bit(raw);
        const int hash = decoded.indexOf(QLatin1Char('#'));
        const QString text = (hash < 0 ? decoded : decoded.left(hash)).trimmed();
        if (text.isEmpty() || keyLine.indexIn(text, 0) == -1)
            continue;
        if (index >= collector.entries.size())
            break;
        ConfEntry &entry = collector.entries[index++];
        entry.lineNumber = lineNumber;
        entry.raw = raw;
        entry.hasComment = hash >= 0;
        if (entry.hasComment)
            entry.comment = decoded.mid(hash + 1).trimmed();
        entry.occurrence = seen.value(entry.key);
        seen[entry.key] = entry.occurrence + 1;
        if (entry.occurrence == 0) {
            firstLine.insert(entry.key, lineNumber);
        } else {
            QList<int> &lines = duplicates[entry.key];
            if (lines.isEmpty())
                lines.append(firstLine.value(entry.key));
            lines.append(lineNumber);
        }
        const QByteArray body = raw.left(raw.size() - lineEndOf(raw).size());
        if (QString::fromLocal8Bit(body).toLocal8Bit() != body)
            entry.problem = tr("Line %1 is not valid text in this system's encoding; it is kept as it is and "
                               "cannot be changed here.").arg(lineNumber);
        else if (entry.value.size() > MaxEditableValue || entry.comment.size() > MaxEditableValue)
            entry.problem = tr("Line %1 is longer than %2 characters; it is kept as it is and cannot be "
                               "changed here.").arg(lineNumber).arg(MaxEditableValue);
        if (!entry.problem.isEmpty())
            result.warnings.append(QStringLiteral("\"%1\": %2").arg(fileName, entry.problem));
    }
    result.lineCount = lineNumber;
    result.endsWithNewline = lineNumber == 0 || raw.endsWith('\n');
    if (index != collector.entries.size()) {
        if (!error.isEmpty())
            error += QLatin1Char('\n');
        error += tr("\"%1\" changed while it was read; read it again.").arg(fileName);
        return false;
    }
    for (auto it = duplicates.cbegin(); it != duplicates.cend(); ++it) {
        QStringList lines;
        for (int line : it.value())
            lines.append(QString::number(line));
        result.warnings.append(tr("\"%1\": the key \"%2\" is set %3 times (lines %4); each line is shown "
                                  "and changed on its own.")
                                   .arg(fileName, it.key())
                                   .arg(it.value().size())
                                   .arg(lines.join(QStringLiteral(", "))));
    }
    result.entries = collector.entries;
    return true;
}

const ConfEntry *find(const ConfFileScan &scan, const QString &key, int occurrence)
{
    for (const ConfEntry &entry : scan.entries) {
        if (entry.key == key && entry.occurrence == occurrence)
            return &entry;
    }
    return nullptr;
}

QByteArray rewrittenLine(const ConfEntry &entry, const QString &value, const QString &comment)
{
    const QByteArray lineEnd = lineEndOf(entry.raw);
    const QString decoded = QString::fromLocal8Bit(entry.raw.left(entry.raw.size() - lineEnd.size()));
    int indent = 0;
    while (indent < decoded.size() && decoded.at(indent).isSpace())
        ++indent;
    QString separator = entry.separator;
    if (separator.isEmpty() && !value.isEmpty())
        separator = QStringLiteral(" ");
    QString line = decoded.left(indent) + entry.key + separator + value;

    const int hash = decoded.indexOf(QLatin1Char('#'));
    if (entry.hasComment && comment == entry.comment) {
        // The comment as it stands, with the spacing before it.
        const QString before = decoded.left(hash);
        int gap = before.size();
        while (gap > 0 && before.at(gap - 1).isSpace())
            --gap;
        line += before.mid(gap) + decoded.mid(hash);
    } else if (!comment.isEmpty()) {
        QString gap = QStringLiteral("  ");
        QString mark = QStringLiteral("# ");
        if (entry.hasComment) {
            const QString before = decoded.left(hash);
            int start = before.size();
            while (start > 0 && before.at(start - 1).isSpace())
                --start;
            gap = before.mid(start);
            if (hash + 1 < decoded.size() && !decoded.at(hash + 1).isSpace())
                mark = QStringLiteral("#");
        }
        line += gap + mark + comment;
    }
    return line.toLocal8Bit() + lineEnd;
}

QByteArray newLine(const QString &key, const QString &separator, const QString &value,
                   const QString &comment, const QByteArray &lineEnd)
{
    QString line = key + separator + value;
    if (!comment.isEmpty())
        line += QStringLiteral("  # ") + comment;
    return line.toLocal8Bit() + lineEnd;
}

QString usualSeparator(const ConfFileScan &scan)
{
    QHash<QString, int> counts;
    QString best = QStringLiteral(" = ");
    int bestCount = 0;
    for (const ConfEntry &entry : scan.entries) {
        if (entry.separator.isEmpty())
            continue;
        const int count = ++counts[entry.separator];
        if (count > bestCount) {
            best = entry.separator;
            bestCount = count;
        }
    }
    return best;
}

LineRewriter::LineRewriter(const QString &key, int occurrence, const QByteArray &expected,
                           const QByteArray &replacement)
    : RegExpHandler(keyLinePattern(key))
    , _occurrence(occurrence)
    , _expected(expected)
    , _replacement(replacement)
{
}

bool LineRewriter::handleRegExp(QByteArray *line)
{
    if (!line || _seen++ != _occurrence)
        return false;
    if (*line != _expected) {
        _conflict = true;
        return false;
    }
    // Returning false writes the bytes as they stand: the line keeps its own
    // comment spacing and line end (CRLF included), which the library's
    // "replaced" path would normalise.
    *line = _replacement;
    _done = true;
    return false;
}

LineAppender::LineAppender(const QString &key, const QByteArray &tail)
    : RegExpHandler(keyLinePattern(key))
    , _tail(tail)
{
}

bool LineAppender::handleRegExp(QByteArray *)
{
    _exists = true;
    return false;
}

bool LineAppender::finalHandleRegExp(QByteArray *tail)
{
    if (_exists || !tail)
        return false;
    *tail = _tail;
    _appended = true;
    return true;
}

} // namespace ConfFileFormat
