// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_REGEXPHANDLER_H
#define KVT_REGEXPHANDLER_H

#include "kvtcommon_export.h"

#include <QByteArray>
#include <QRegExp>
#include <QString>

/*!
 * Reads and rewrites a line-oriented configuration file ("key = value" lines
 * with "#" comments) under one regular expression.
 *
 * A subclass gives the expression and handles the lines that match it. A line
 * is a candidate when the text before its first "#", trimmed, is not empty;
 * the expression is searched in that text, and its captures are what
 * handleRegExp() reads through regExp(). Every other line is copied byte for
 * byte.
 *
 * A rewrite goes through a work copy "<file>.tmp" beside the file, can keep a
 * backup "<file>.bak", and copies the result back with the system cp, which
 * rewrites the file in place and so keeps its inode, mode and owner. Nothing
 * is thrown: the operations return false and append a message to the
 * caller's error text ("\n" first when the text is not empty).
 *
 * A rewrite that is killed, or loses power, at any moment leaves a whole
 * version on the disk: the work copy is written without a name, synced, and
 * only then named "<file>.tmp" and copied back; the file is synced before the
 * work copy goes. The next rewrite finishes an interrupted one (or removes a
 * work copy whose content the file already has), and refuses with a message
 * when the file has changed since. A read of a file cut short by an
 * interrupted copy back reads the complete work copy instead. A work name
 * taken by anything but a regular file of our own (a link, a device, another
 * user's file) is never written through: the rewrite is refused. A failure
 * otherwise leaves the files as they were at that point; there is no
 * rollback.
 *
 * Two rewrites of the same file at the same time would share the work copy;
 * callers keep them apart.
 */
class KVTCOMMON_EXPORT RegExpHandler
{
public:
    /*!
     * Creates the handler of the regular expression \a pattern (case-sensitive, QRegExp::RegExp syntax).
     */
    explicit RegExpHandler(const QString &pattern);
    virtual ~RegExpHandler();

    /*!
     * Called for every matching line. In a rewrite \a line holds the raw bytes
     * of the line, terminator included. Return true after replacing it by bare
     * content without a terminator: the line's comment and a "\n" are then
     * added. Return false to have \a line written exactly as it stands
     * (unchanged keeps the line, emptied deletes it). In a read \a line is
     * null and the result is ignored.
     */
    virtual bool handleRegExp(QByteArray *line) = 0;

    /*!
     * Called once at the end of a rewrite with an empty \a tail. Return true
     * to have \a tail written at the end of the file as it stands (line
     * terminators included). The default appends nothing.
     */
    virtual bool finalHandleRegExp(QByteArray *tail);

    /*!
     * The expression, holding the captures of the last match. It is consulted
     * afresh for every line, so a subclass may change it between lines.
     */
    QRegExp &regExp() { return _regExp; }
    //! The expression, holding the captures of the last match.
    const QRegExp &regExp() const { return _regExp; }

    /*!
     * Reads \a fileName and calls handleRegExp(nullptr) for every matching line.
     * Returns false and extends \a error when the file is missing or unreadable.
     */
    static bool readSystemConfigureFile(const QString &fileName, RegExpHandler &handler, QString &error);
    /*!
     * Rewrites \a fileName through the handler, keeping a backup "<file>.bak" when
     * \a backup is true. Returns false and extends \a error on any failure.
     */
    static bool rewriteSystemConfigureFile(const QString &fileName, RegExpHandler &handler, QString &error,
                                           bool backup);

    /*!
     * Copies \a source over \a destination with
     * "cp --force --preserve=mode,ownership", waiting up to 30 seconds for the
     * start and again for the end. A relative path that begins with "-" is
     * given to cp as "./-..." so that it is not taken for an option.
     */
    static bool safeCopy(const QString &source, const QString &destination, QString &error);

private:
    QRegExp _regExp;
};

#endif
