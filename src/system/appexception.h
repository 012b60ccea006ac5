// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_APPEXCEPTION_H
#define KVT_APPEXCEPTION_H

#include "kvtcommon_export.h"

#include <QException>
#include <QMetaType>
#include <QString>

/*!
 * The library's one exception type: a single human-readable, already
 * translated message.
 *
 * Catch it by const reference and read the message with getText().
 *
 * raise() and clone() are deliberately inherited from QException: an
 * AppException that crosses a QtConcurrent boundary arrives as a plain
 * QException without its text, so code running in a worker catches
 * AppException itself.
 */
class KVTCOMMON_EXPORT AppException : public QException
{
public:
    // The default argument only serves the meta-type system, which needs a
    // default-constructible type to queue the exception through a signal.
    //! Creates an exception with the message \a text (already translated).
    explicit AppException(const QString &text = QString());
    //! Copies the message.
    AppException(const AppException &other);
    //! Copies the message.
    AppException &operator=(const AppException &other);
    ~AppException() noexcept override;

    /*!
     * The message in the local 8-bit encoding. The pointer stays valid until
     * this exception object is destroyed or assigned to.
     */
    const char *what() const noexcept override;

    //! The message.
    const QString &getText() const { return _text; }

private:
    QString _text;
};

Q_DECLARE_METATYPE(AppException)

#endif
