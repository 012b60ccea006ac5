#include <kvt-common/streaminterceptor.h>

#include <QFile>
#include <QtTest>

#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

// Results are gathered while a stream is intercepted and only compared after
// the interceptor is gone: a failing QCOMPARE would otherwise write its report
// into the captured stream.

Q_DECLARE_METATYPE(FILE *)

namespace {

// What a descriptor refers to, to tell whether it was restored.
QByteArray identity(int fd)
{
    struct stat st = {};
    return ::fstat(fd, &st) != 0 ? QByteArray("closed")
                                 : QByteArray::number(qulonglong(st.st_dev)) + ':' + QByteArray::number(qulonglong(st.st_ino));
}

void writeRaw(int fd, const QByteArray &bytes)
{
    for (qint64 done = 0, n = 1; n > 0 && done < bytes.size(); done += n)
        n = ::write(fd, bytes.constData() + done, size_t(bytes.size() - done));
}

// Opens descriptors until none is left and returns them.
QVector<int> openAll()
{
    QVector<int> opened;
    for (int fd; (fd = ::open("/dev/null", O_RDONLY | O_CLOEXEC)) >= 0;)
        opened << fd;
    return opened;
}

int closeAll(const QVector<int> &fds)
{
    for (int fd : fds)
        ::close(fd);
    return fds.size();
}

} // namespace

class StreamInterceptorTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void capturesEverything_data();
    void capturesEverything();
    void failedSetupLeavesStreamAlone_data();
    void failedSetupLeavesStreamAlone();
    void invalidStreams();
};

void StreamInterceptorTest::capturesEverything_data()
{
    QTest::addColumn<FILE *>("stream");
    QTest::newRow("standard output") << stdout;
    QTest::newRow("standard error") << stderr;
}

void StreamInterceptorTest::capturesEverything()
{
    QFETCH(FILE *, stream);
    const int fd = fileno(stream);
    const QByteArray before = identity(fd);
    const QByteArray big(1024 * 1024, 'x');
    QString tempName;
    QByteArray first, second, inner, outerIdentity, afterInner;
    {
        StreamInterceptor interceptor(stream);
        tempName = interceptor.fileName();
        outerIdentity = identity(fd);
        std::fprintf(stream, "stdio %d;", 42);
        std::fflush(stream);
        {
            StreamInterceptor nested(stream); // interceptors nest, last in, first out
            writeRaw(fd, "nested");
            inner = nested.streamReadAll();
        }
        afterInner = identity(fd);
        writeRaw(fd, "raw write;");
        // A child inherits the redirected descriptor.
        if (std::system(("printf 'child;' >&" + QByteArray::number(fd)).constData()) != 0)
            writeRaw(fd, "<system failed>");
        writeRaw(fd, big);
        first = interceptor.streamReadAll();
        writeRaw(fd, "end");
        second = interceptor.streamReadAll();
    }
    QVERIFY(!QFile::exists(tempName));
    QCOMPARE(inner, QByteArray("nested"));
    QCOMPARE(afterInner, outerIdentity);
    QCOMPARE(identity(fd), before);
    const QByteArray expected = "stdio 42;raw write;child;" + big;
    QVERIFY2(first == expected, first.left(80).constData());
    // Reading consumes nothing: the second read starts from the beginning.
    QVERIFY(second == expected + "end");
}

void StreamInterceptorTest::failedSetupLeavesStreamAlone_data()
{
    // One free descriptor: only the duplicate fits, the temporary file does
    // not. Two: the temporary file fits, the appending stream does not. Three:
    // everything fits.
    QTest::addColumn<int>("free");
    QTest::newRow("no room for the temporary file") << 1;
    QTest::newRow("no room for the appending stream") << 2;
    QTest::newRow("enough room") << 3;
}

void StreamInterceptorTest::failedSetupLeavesStreamAlone()
{
    QFETCH(int, free);
    const bool intercepts = free == 3;
    const QByteArray original = identity(STDERR_FILENO);
    QByteArray captured, during;
    // Lower the limit, occupy every slot below it, then free exactly `free`.
    struct rlimit saved;
    ::getrlimit(RLIMIT_NOFILE, &saved);
    const int lowest = ::dup(0);
    ::close(lowest);
    struct rlimit squeezed = saved;
    squeezed.rlim_cur = rlim_t(lowest + free + 8);
    ::setrlimit(RLIMIT_NOFILE, &squeezed);
    QVector<int> fillers = openAll();
    closeAll(fillers.mid(fillers.size() - free));
    fillers.resize(fillers.size() - free);
    const int availableBefore = closeAll(openAll());
    {
        StreamInterceptor interceptor(stderr);
        during = identity(STDERR_FILENO);
        if (intercepts)
            writeRaw(STDERR_FILENO, "caught");
        captured = interceptor.streamReadAll();
    }
    // Every descriptor taken on the way is given back.
    const int availableAfter = closeAll(openAll());
    closeAll(fillers);
    ::setrlimit(RLIMIT_NOFILE, &saved);
    QCOMPARE(availableBefore, free);
    QCOMPARE(availableAfter, free);
    QCOMPARE(identity(STDERR_FILENO), original);
    QCOMPARE(during == original, !intercepts);
    QCOMPARE(captured, intercepts ? QByteArray("caught") : QByteArray());
}

void StreamInterceptorTest::invalidStreams()
{
    // A closed descriptor cannot be duplicated: the object stays idle and its
    // destruction puts nothing on that descriptor.
    FILE *broken = std::fopen("/dev/null", "w");
    QVERIFY(broken);
    const int fd = fileno(broken);
    ::close(fd);
    const QByteArray captured = StreamInterceptor(broken).streamReadAll();
    const bool stillClosed = ::fcntl(fd, F_GETFD) == -1;
    std::fclose(broken);
    QVERIFY(captured.isEmpty() && stillClosed);
    QVERIFY(StreamInterceptor(nullptr).streamReadAll().isEmpty());
}

QTEST_GUILESS_MAIN(StreamInterceptorTest)
#include "tst_streaminterceptor.moc"
