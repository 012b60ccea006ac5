// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "streaminterceptor.h"

#include <QFile>

#include <fcntl.h>
#include <unistd.h>

namespace {

// Programs started while the interception is on inherit the redirected
// descriptor, which is wanted; they need not inherit our private ones.
void closeOnExec(int fd)
{
    const int flags = ::fcntl(fd, F_GETFD);
    if (flags != -1)
        ::fcntl(fd, F_SETFD, flags | FD_CLOEXEC);
}

} // namespace

StreamInterceptor::StreamInterceptor(FILE *stream)
    : _fd(stream ? fileno(stream) : -1)
    , _savedFd(_fd >= 0 ? ::dup(_fd) : -1)
    , _file(nullptr)
{
    if (_savedFd == -1)
        return;
    closeOnExec(_savedFd);

    // The file is created (and its name fixed) by opening it once; the
    // descriptor redirection then goes through a stream of our own.
    if (!QTemporaryFile::open()) {
        ::close(_savedFd);
        _savedFd = -1;
        return;
    }
    close();

    // Whatever the program printed before now still goes where it went.
    std::fflush(stream);

    _file = std::fopen(QFile::encodeName(fileName()).constData(), "a");
    if (!_file) {
        ::close(_savedFd);
        _savedFd = -1;
        return;
    }
    closeOnExec(fileno(_file));
    if (::dup2(fileno(_file), _fd) == -1) {
        ::close(_savedFd);
        _savedFd = -1;
        std::fclose(_file);
        _file = nullptr;
    }
}

StreamInterceptor::~StreamInterceptor()
{
    if (!_file)
        return;
    std::fflush(_file);
    ::dup2(_savedFd, _fd);
    std::fclose(_file);
    ::close(_savedFd);
}

QByteArray StreamInterceptor::streamReadAll()
{
    if (!_file)
        return QByteArray();
    if (!open(QIODevice::ReadOnly))
        return QByteArray();
    std::fflush(_file);
    seek(0);
    const QByteArray bytes = readAll();
    close();
    return bytes;
}
