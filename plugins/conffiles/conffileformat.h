// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#ifndef CONFFILES_CONFFILEFORMAT_H
#define CONFFILES_CONFFILEFORMAT_H

#include <kvt-common/regexphandler.h>

#include <QByteArray>
#include <QCoreApplication>
#include <QString>
#include <QStringList>
#include <QVector>

/*!
 * One "key = value" (or "key value") line of a configuration file, as read.
 *
 * The key, separator and value come from the library's read of the file; the
 * line number, the raw bytes and the comment from a second pass over the
 * same lines. A line is changed only when its bytes on disk are still the
 * ones recorded here.
 */
struct ConfEntry
{
    QString key;
    QString separator;      //!< between key and value: " = ", "=", " " or empty
    QString value;
    QString comment;        //!< the text after "#", trimmed; empty without comment
    bool hasComment = false;
    int lineNumber = 0;     //!< 1-based
    int occurrence = 0;     //!< 0 for the first line of this key, 1 for the second...
    QByteArray raw;         //!< the line's bytes, terminator included
    QString problem;        //!< why the line cannot be changed here; empty when it can
};

//! What a read of a whole file found.
struct ConfFileScan
{
    QVector<ConfEntry> entries;
    QStringList warnings;   //!< duplicate keys, lines that cannot be changed
    bool endsWithNewline = true;
    QByteArray lineEnd = QByteArrayLiteral("\n"); //!< "\r\n" for a file whose first line ends so
    int lineCount = 0;
};

namespace ConfFileFormat {

//! The longest value an edit field holds; longer lines are shown but not changed.
constexpr int MaxEditableValue = 32767;

//! The expression of every key line: key, separator, value.
QString keyLinesPattern();
//! The expression of the lines of \a key, its metacharacters escaped.
QString keyLinePattern(const QString &key);

//! Empty when \a key can be written as a key, else why not.
QString keyProblem(const QString &key);
//! Empty when \a value can be written as a value, else why not.
QString valueProblem(const QString &value);
//! Empty when \a comment can be written as a comment, else why not.
QString commentProblem(const QString &comment);

/*!
 * Reads \a fileName with the library (RegExpHandler::readSystemConfigureFile)
 * and attaches line numbers, raw bytes and comments. False with the
 * library's message appended to \a error when the file cannot be read.
 */
bool scan(const QString &fileName, ConfFileScan &result, QString &error);

//! The first entry of \a key's \a occurrence, or null.
const ConfEntry *find(const ConfFileScan &scan, const QString &key, int occurrence);

//! The bytes of \a entry's line with a new value and comment; indentation,
//! separator, the spacing before the comment and the line end are kept.
QByteArray rewrittenLine(const ConfEntry &entry, const QString &value, const QString &comment);

//! The bytes of a new line ending in \a lineEnd.
QByteArray newLine(const QString &key, const QString &separator, const QString &value,
                   const QString &comment, const QByteArray &lineEnd);

//! The separator most of the file's lines use, " = " for a file without keys.
QString usualSeparator(const ConfFileScan &scan);

/*!
 * Replaces (or, with an empty replacement, deletes) one line of a key in a
 * rewrite: the \a occurrence-th line of the key, and only if its bytes are
 * still \a expected. Every other line is kept as it is.
 */
class LineRewriter : public RegExpHandler
{
public:
    LineRewriter(const QString &key, int occurrence, const QByteArray &expected,
                 const QByteArray &replacement);
    bool handleRegExp(QByteArray *line) override;
    bool done() const { return _done; }
    bool conflict() const { return _conflict; }

private:
    int _occurrence;
    int _seen = 0;
    QByteArray _expected;
    QByteArray _replacement;
    bool _done = false;
    bool _conflict = false;
};

/*!
 * Appends a line in a rewrite, unless a line of the same key turns up on the
 * way (the key was added meanwhile): then nothing is appended.
 */
class LineAppender : public RegExpHandler
{
public:
    LineAppender(const QString &key, const QByteArray &tail);
    bool handleRegExp(QByteArray *line) override;
    bool finalHandleRegExp(QByteArray *tail) override;
    bool appended() const { return _appended; }

private:
    QByteArray _tail;
    bool _exists = false;
    bool _appended = false;
};

} // namespace ConfFileFormat

#endif
