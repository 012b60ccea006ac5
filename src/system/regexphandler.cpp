// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "regexphandler.h"

#include "configlines_p.h"
#include "kvtlogging_p.h"

#include <QFile>
#include <QFileInfo>
#include <QObject>
#include <QProcess>
#include <QStringList>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <vector>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

const int copyTimeoutMs = 30000;

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

// The same message for a failed system call on \a fileName.
void appendSystemError(QString &error, const QString &fileName, QFileDevice::FileError kind, int errorCode)
{
    appendError(error, QObject::tr("\"%1\" error %2\n%3")
                           .arg(fileName, QString::number(int(kind)), qt_error_string(errorCode)));
}

void appendForeignWorkFile(QString &error, const QString &workName)
{
    appendError(error, QObject::tr("\"%1\" is not a regular file of its own (a link, a device or another user's file); "
                                   "nothing was written through it")
                           .arg(workName));
}

class FileDescriptor
{
public:
    explicit FileDescriptor(int fd = -1)
        : _fd(fd)
    {
    }
    ~FileDescriptor() { reset(); }
    FileDescriptor(const FileDescriptor &) = delete;
    FileDescriptor &operator=(const FileDescriptor &) = delete;

    int get() const { return _fd; }
    bool isValid() const { return _fd >= 0; }
    void reset(int fd = -1)
    {
        if (_fd >= 0)
            ::close(_fd);
        _fd = fd;
    }

private:
    int _fd;
};

bool sameTime(const struct timespec &a, const struct timespec &b)
{
    return a.tv_sec == b.tv_sec && a.tv_nsec == b.tv_nsec;
}

// Flushes the content of \a fileName to the disk.
bool syncFile(const QString &fileName, QString &error)
{
    const FileDescriptor fd(::open(QFile::encodeName(fileName).constData(), O_RDONLY | O_CLOEXEC));
    if (!fd.isValid() || ::fsync(fd.get()) != 0) {
        appendSystemError(error, fileName, QFileDevice::WriteError, errno);
        return false;
    }
    return true;
}

// Makes the names in the folder of \a fileName durable. Some file systems
// cannot sync a folder; their names are as durable as they get.
void syncFolder(const QString &fileName)
{
    const FileDescriptor fd(
        ::open(QFile::encodeName(QFileInfo(fileName).absolutePath()).constData(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    if (fd.isValid() && ::fsync(fd.get()) != 0 && errno != EINVAL && errno != EROFS)
        qCWarning(KVT_SYSTEM, "cannot sync the folder of %s: %s", qPrintable(fileName), qPrintable(qt_error_string(errno)));
}

// Whether the content of \a a equals that of \a b, or (with \a prefix) is
// a strict beginning of it. Both are read from their start.
bool compareContent(int a, int b, bool prefix)
{
    struct stat sa = {};
    struct stat sb = {};
    if (::fstat(a, &sa) != 0 || ::fstat(b, &sb) != 0 || (prefix ? sa.st_size >= sb.st_size : sa.st_size != sb.st_size))
        return false;
    if (::lseek(a, 0, SEEK_SET) != 0 || ::lseek(b, 0, SEEK_SET) != 0)
        return false;
    static const size_t blockSize = 1 << 16;
    std::vector<char> blockA(blockSize);
    std::vector<char> blockB(blockSize);
    for (;;) {
        const ssize_t got = ::read(a, blockA.data(), blockSize);
        if (got < 0)
            return false;
        if (got == 0)
            return true;
        ssize_t have = 0;
        while (have < got) {
            const ssize_t more = ::read(b, blockB.data() + have, size_t(got - have));
            if (more <= 0)
                return false;
            have += more;
        }
        if (std::memcmp(blockA.data(), blockB.data(), size_t(got)) != 0)
            return false;
    }
}

// A work copy "<file>.tmp" found beside the file: left by an interrupted
// rewrite, or something else that happens to carry the name.
struct WorkFileTrace {
    enum Kind { None, Foreign, Unreadable, Own };
    Kind kind = None;
    int errorCode = 0;
    FileDescriptor fd;
    struct stat status = {};
};

// Opens the work copy without following a link and without waiting on a
// device or a pipe. It is the library's own only when it is a regular file
// with no other name, owned by this user or by the file's owner.
void inspectWorkFile(const QString &workName, const struct stat &target, WorkFileTrace &trace)
{
    trace.fd.reset(::open(QFile::encodeName(workName).constData(),
                          O_RDONLY | O_NOFOLLOW | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
    if (!trace.fd.isValid()) {
        trace.errorCode = errno;
        trace.kind = errno == ENOENT ? WorkFileTrace::None
                     : errno == ELOOP ? WorkFileTrace::Foreign
                                      : WorkFileTrace::Unreadable;
        if (trace.kind == WorkFileTrace::Unreadable) {
            // Not readable by us, yet perhaps not a regular file either.
            struct stat st = {};
            if (::lstat(QFile::encodeName(workName).constData(), &st) == 0 && !S_ISREG(st.st_mode))
                trace.kind = WorkFileTrace::Foreign;
        }
        return;
    }
    if (::fstat(trace.fd.get(), &trace.status) != 0) {
        trace.errorCode = errno;
        trace.kind = WorkFileTrace::Unreadable;
        return;
    }
    const bool own = S_ISREG(trace.status.st_mode) && trace.status.st_nlink == 1
                     && (trace.status.st_uid == ::geteuid() || trace.status.st_uid == target.st_uid);
    trace.kind = own ? WorkFileTrace::Own : WorkFileTrace::Foreign;
}

// The new content of a rewrite, written first into a file without a name in
// the folder of the file, and given the work name only once it is complete
// and on the disk. So "<file>.tmp" always holds a whole new version: while it
// is copied back over the file, and after an interruption, it is the copy
// that is complete.
class WorkFile
{
public:
    explicit WorkFile(const QString &name)
        : _name(name)
        , _native(QFile::encodeName(name))
    {
    }
    ~WorkFile()
    {
        _fd.reset();
        if (!_tempName.isEmpty() && !_published)
            ::unlink(_tempName.constData());
    }

    int handle() const { return _fd.get(); }

    // Creates the nameless file with the mode and owner of \a target.
    bool create(const struct stat &target, QString &error)
    {
        const QByteArray folder = QFile::encodeName(QFileInfo(_name).absolutePath());
        _fd.reset(::open(folder.constData(), O_TMPFILE | O_WRONLY | O_CLOEXEC, 0600));
        if (!_fd.isValid() && (errno == EOPNOTSUPP || errno == EISDIR || errno == EINVAL)) {
            // The file system has no nameless files: a unique name beside the
            // work name stands in, and a failure removes it.
            QByteArray pattern = _native + ".XXXXXX";
            _fd.reset(::mkostemp(pattern.data(), O_CLOEXEC));
            if (_fd.isValid())
                _tempName = pattern;
        }
        if (!_fd.isValid()) {
            appendSystemError(error, _name, QFileDevice::OpenError, errno);
            return false;
        }
        // As cp --preserve=mode,ownership does: without the right to give the
        // file away it stays ours, and then loses its set-id bits.
        mode_t mode = target.st_mode & 07777;
        if (::fchown(_fd.get(), target.st_uid, target.st_gid) != 0) {
            if (errno != EPERM && errno != EINVAL) {
                appendSystemError(error, _name, QFileDevice::PermissionsError, errno);
                return false;
            }
            mode &= ~mode_t(S_ISUID | S_ISGID);
        }
        if (::fchmod(_fd.get(), mode) != 0) {
            appendSystemError(error, _name, QFileDevice::PermissionsError, errno);
            return false;
        }
        return true;
    }

    // Puts the complete content on the disk and gives the file its name.
    // Its modification time is set to the file's: a trace of a rewrite that
    // stopped before copying back is recognised by it.
    bool publish(const struct stat &target, QString &error)
    {
        const struct timespec times[2] = {target.st_atim, target.st_mtim};
        if (::futimens(_fd.get(), times) != 0 || ::fsync(_fd.get()) != 0) {
            appendSystemError(error, _name, QFileDevice::WriteError, errno);
            return false;
        }
        int result = 0;
        if (_tempName.isEmpty()) {
            char path[64];
            std::snprintf(path, sizeof path, "/proc/self/fd/%d", _fd.get());
            result = ::linkat(AT_FDCWD, path, AT_FDCWD, _native.constData(), AT_SYMLINK_FOLLOW);
            if (result != 0 && errno != EEXIST) {
                const int procError = errno;
                result = ::linkat(_fd.get(), "", AT_FDCWD, _native.constData(), AT_EMPTY_PATH);
                if (result != 0 && errno != EEXIST)
                    errno = procError;
            }
        } else {
            // link() and not rename(): whatever took the name meanwhile stays.
            result = ::link(_tempName.constData(), _native.constData());
            if (result == 0) {
                ::unlink(_tempName.constData());
                _published = true;
            }
        }
        if (result != 0) {
            if (errno == EEXIST)
                appendForeignWorkFile(error, _name);
            else
                appendSystemError(error, _name, QFileDevice::WriteError, errno);
            return false;
        }
        _published = true;
        syncFolder(_name);
        return true;
    }

private:
    QString _name;
    QByteArray _native;
    QByteArray _tempName;
    FileDescriptor _fd;
    bool _published = false;
};

// Deals with a work copy left beside \a fileName before a rewrite starts:
// - the same content as the file: the rewrite had finished; it is removed;
// - a longer content that the file begins with: the copy back was cut short,
//   and the work copy is put in place;
// - the modification time of the file: the rewrite stopped before copying
//   back; it is finished the same way;
// - anything else (the file changed since, or the work copy is not one of
//   ours): both stay as they are and the rewrite is refused with a message.
bool settleInterruptedRewrite(const QString &fileName, const QString &workName, QString &error)
{
    const FileDescriptor target(::open(QFile::encodeName(fileName).constData(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
    struct stat targetStatus = {};
    if (!target.isValid() || ::fstat(target.get(), &targetStatus) != 0) {
        appendSystemError(error, fileName, QFileDevice::OpenError, errno);
        return false;
    }
    WorkFileTrace trace;
    inspectWorkFile(workName, targetStatus, trace);
    switch (trace.kind) {
    case WorkFileTrace::None:
        return true;
    case WorkFileTrace::Foreign:
        appendForeignWorkFile(error, workName);
        return false;
    case WorkFileTrace::Unreadable:
        appendSystemError(error, workName, QFileDevice::OpenError, trace.errorCode);
        return false;
    case WorkFileTrace::Own:
        break;
    }

    if (compareContent(target.get(), trace.fd.get(), false)) {
        if (::unlink(QFile::encodeName(workName).constData()) != 0) {
            appendSystemError(error, workName, QFileDevice::RemoveError, errno);
            return false;
        }
        return true;
    }
    const bool cutShort = compareContent(target.get(), trace.fd.get(), true);
    if (!cutShort && !sameTime(trace.status.st_mtim, targetStatus.st_mtim)) {
        appendError(error, QObject::tr("\"%1\" holds a version of \"%2\" from a rewrite that was interrupted, and "
                                       "\"%2\" has changed since; keep the one you want and remove \"%1\"")
                               .arg(workName, fileName));
        return false;
    }
    qCWarning(KVT_SYSTEM, "finishing an interrupted rewrite of %s", qPrintable(fileName));
    if (!RegExpHandler::safeCopy(workName, fileName, error) || !syncFile(fileName, error))
        return false;
    if (::unlink(QFile::encodeName(workName).constData()) != 0) {
        appendSystemError(error, workName, QFileDevice::RemoveError, errno);
        return false;
    }
    syncFolder(workName);
    return true;
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

    // A rewrite cut short while copying back leaves the file a beginning of
    // its work copy, which holds the whole new version: that is read instead.
    const FileDescriptor probe(::open(QFile::encodeName(fileName).constData(), O_RDONLY | O_NONBLOCK | O_CLOEXEC));
    struct stat targetStatus = {};
    WorkFileTrace trace;
    if (probe.isValid() && ::fstat(probe.get(), &targetStatus) == 0 && S_ISREG(targetStatus.st_mode))
        inspectWorkFile(QStringLiteral("%1.tmp").arg(fileName), targetStatus, trace);
    QFile work;
    if (trace.kind == WorkFileTrace::Own && compareContent(probe.get(), trace.fd.get(), true)
        && ::lseek(trace.fd.get(), 0, SEEK_SET) == 0 && work.open(trace.fd.get(), QIODevice::ReadOnly)) {
        qCWarning(KVT_SYSTEM, "%s was cut short by an interrupted rewrite; reading its work copy", qPrintable(fileName));
        KvtConfigLines::readLines(work, handler);
    } else {
        KvtConfigLines::readLines(file, handler);
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

    // At every moment a whole version of the file is on the disk: the file
    // itself, or the work copy "<file>.tmp" that is complete before it is
    // copied back. A work copy left by an interrupted rewrite is dealt with
    // first, and one that is not a file of our own is never written through.
    const QString workName = QStringLiteral("%1.tmp").arg(fileName);
    if (!settleInterruptedRewrite(fileName, workName, error))
        return false;

    QFile target(fileName);
    if (!target.open(QIODevice::ReadOnly)) {
        appendFileError(error, target);
        return false;
    }
    struct stat targetStatus = {};
    if (::fstat(target.handle(), &targetStatus) != 0) {
        appendSystemError(error, fileName, QFileDevice::OpenError, errno);
        return false;
    }
    WorkFile work(workName);
    if (!work.create(targetStatus, error))
        return false;
    // Every byte is checked: a short write (a full disk, a size limit) is an
    // error, and a work copy that could not be written completely is never
    // copied over the file.
    int writeError = 0;
    const bool written = KvtConfigLines::rewriteLines(target, handler, [&](const QByteArray &block) {
        const char *data = block.constData();
        qint64 left = block.size();
        while (left > 0) {
            const ssize_t n = ::write(work.handle(), data, size_t(left));
            if (n < 0 && errno == EINTR)
                continue;
            if (n <= 0) {
                writeError = n < 0 ? errno : ENOSPC;
                return false;
            }
            data += n;
            left -= n;
        }
        return true;
    });
    if (!written) {
        appendSystemError(error, workName, QFileDevice::WriteError, writeError);
        return false;
    }
    if (target.error() != QFileDevice::NoError) {
        appendFileError(error, target); // before close(), which forgets the error
        return false;
    }
    target.close();

    if (backup) {
        // Made before the work copy gets its name: when it fails, no complete
        // work copy is left for the next rewrite to put in place.
        const QString backupName = QStringLiteral("%1.bak").arg(fileName);
        if (QFile::exists(backupName))
            QFile::remove(backupName);
        if (!target.copy(backupName)) {
            appendFileError(error, target);
            return false;
        }
    }

    if (!work.publish(targetStatus, error))
        return false;

    // cp rewrites the file in place (inode, mode and owner kept). If it stops
    // half-way, the work copy stays: it is then the complete version.
    if (!safeCopy(workName, fileName, error) || !syncFile(fileName, error))
        return false;

    QFile published(workName);
    if (!published.remove()) {
        // The file already has its new content; only the clean-up failed.
        appendFileError(error, published);
        return false;
    }
    syncFolder(workName);
    return true;
}

bool RegExpHandler::safeCopy(const QString &source, const QString &destination, QString &error)
{
    const QString program = QStringLiteral("cp");
    // A relative path that begins with "-" would be read by cp as an option.
    const auto operand = [](const QString &path) {
        return path.startsWith(QLatin1Char('-')) ? QStringLiteral("./") + path : path;
    };
    const QStringList arguments{QStringLiteral("--force"), QStringLiteral("--preserve=mode,ownership"), operand(source),
                                operand(destination)};
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
