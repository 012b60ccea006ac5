// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_STREAMINTERCEPTOR_H
#define KVT_STREAMINTERCEPTOR_H

#include "kvtcommon_export.h"

#include <QByteArray>
#include <QTemporaryFile>

#include <cstdio>

/*!
 * Captures everything written to a standard stream (stdout or stderr) while
 * the object lives, at the file-descriptor level: output of the process and
 * of every library it calls, plain write() calls on the descriptor included.
 *
 * The text goes to a temporary file and can be read back at any time with
 * streamReadAll(). Destruction puts the stream back where it was and removes
 * the file. Interceptors on the same stream nest in last-in, first-out order.
 *
 * Failures are silent: when the descriptor cannot be duplicated or the file
 * cannot be set up, nothing is intercepted and streamReadAll() returns an
 * empty array. The redirection affects every thread of the process; create
 * and destroy the object on one thread, around the code whose output is
 * wanted.
 */
class KVTCOMMON_EXPORT StreamInterceptor : public QTemporaryFile
{
public:
    //! Starts capturing \a stream (stdout or stderr); the stream is flushed first.
    explicit StreamInterceptor(FILE *stream);
    ~StreamInterceptor() override;

    /*!
     * Everything captured so far, from the start. Data still buffered inside
     * the intercepted FILE is not included: flush the stream first.
     */
    QByteArray streamReadAll();

private:
    int _fd;
    int _savedFd;
    FILE *_file;
};

#endif
