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

// Identity of whatever a descriptor refers to, to tell whether it was
// restored.
QByteArray identity(int fd)
{
    struct stat st;
    if (::fstat(fd, &st) != 0)
        return QByteArray("closed");
    return QByteArray::number(qulonglong(st.st_dev)) + ':' + QByteArray::number(qulonglong(st.st_ino));
}

void writeRaw(int fd, const QByteArray &bytes)
{
    qint64 done = 0;
    while (done < bytes.size()) {
        const ssize_t n = ::write(fd, bytes.constData() + done, size_t(bytes.size() - done));
        if (n <= 0)
            return;
        done += n;
    }
}

// Leaves exactly `free` descriptors available to the process while it lives,
// by lowering the descriptor limit and occupying every other free slot below
// it.
class DescriptorSqueeze
{
public:
    explicit DescriptorSqueeze(int free)
    {
        ::getrlimit(RLIMIT_NOFILE, &_saved);
        const int lowest = ::dup(0);
        ::close(lowest);
        struct rlimit squeezed = _saved;
        squeezed.rlim_cur = rlim_t(lowest + free + 8);
        ::setrlimit(RLIMIT_NOFILE, &squeezed);
        for (;;) {
            const int fd = ::open("/dev/null", O_RDONLY | O_CLOEXEC);
            if (fd < 0)
                break;
            _fillers << fd;
        }
        for (int i = 0; i < free && !_fillers.isEmpty(); ++i)
            ::close(_fillers.takeLast());
    }

    ~DescriptorSqueeze()
    {
        for (int fd : qAsConst(_fillers))
            ::close(fd);
        ::setrlimit(RLIMIT_NOFILE, &_saved);
    }

    // How many descriptors can be opened right now.
    static int available()
    {
        QVector<int> opened;
        for (;;) {
            const int fd = ::open("/dev/null", O_RDONLY | O_CLOEXEC);
            if (fd < 0)
                break;
            opened << fd;
        }
        for (int fd : qAsConst(opened))
            ::close(fd);
        return opened.size();
    }

private:
    struct rlimit _saved;
    QVector<int> _fillers;
};

} // namespace

class StreamInterceptorTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void capturesEverything_data();
    void capturesEverything();
    void unflushedOutputIsMissing();
    void nestingRestoresInOrder();
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
    bool existedWhileActive = false;
    QByteArray first;
    QByteArray second;
    {
        StreamInterceptor interceptor(stream);
        tempName = interceptor.fileName();
        existedWhileActive = QFile::exists(tempName);
        std::fprintf(stream, "stdio %d;", 42);
        std::fflush(stream);
        writeRaw(fd, "raw write;");
        // A child inherits the redirected descriptor.
        const QByteArray command = "printf 'child;' >&" + QByteArray::number(fd);
        if (std::system(command.constData()) != 0)
            writeRaw(fd, "<system failed>");
        writeRaw(fd, big);
        first = interceptor.streamReadAll();
        writeRaw(fd, "end");
        second = interceptor.streamReadAll();
    }

    QVERIFY(existedWhileActive);
    QVERIFY(!QFile::exists(tempName));
    QCOMPARE(identity(fd), before);
    const QByteArray expected = "stdio 42;raw write;child;" + big;
    QVERIFY2(first == expected, first.left(80).constData());
    // Reading consumes nothing: the second read starts from the beginning.
    QVERIFY(second == expected + "end");
}

void StreamInterceptorTest::unflushedOutputIsMissing()
{
    QByteArray beforeFlush;
    QByteArray afterFlush;
    {
        std::fflush(stdout);
        StreamInterceptor interceptor(stdout);
        // Without a newline the text stays in the stdio buffer, whether stdout
        // is a terminal or not.
        std::fputs("pending", stdout);
        beforeFlush = interceptor.streamReadAll();
        std::fflush(stdout);
        afterFlush = interceptor.streamReadAll();
    }
    QCOMPARE(beforeFlush, QByteArray());
    QCOMPARE(afterFlush, QByteArray("pending"));
}

void StreamInterceptorTest::nestingRestoresInOrder()
{
    const QByteArray original = identity(STDERR_FILENO);
    QByteArray outerText;
    QByteArray innerText;
    QByteArray betweenIdentity;
    {
        StreamInterceptor outer(stderr);
        const QByteArray outerIdentity = identity(STDERR_FILENO);
        writeRaw(STDERR_FILENO, "A");
        {
            StreamInterceptor inner(stderr);
            writeRaw(STDERR_FILENO, "B");
            innerText = inner.streamReadAll();
        }
        betweenIdentity = identity(STDERR_FILENO) == outerIdentity ? "outer" : "other";
        writeRaw(STDERR_FILENO, "C");
        outerText = outer.streamReadAll();
    }
    QCOMPARE(innerText, QByteArray("B"));
    QCOMPARE(outerText, QByteArray("AC"));
    QCOMPARE(betweenIdentity, QByteArray("outer"));
    QCOMPARE(identity(STDERR_FILENO), original);
}

void StreamInterceptorTest::failedSetupLeavesStreamAlone_data()
{
    // One descriptor: only the duplicate fits, the temporary file does not.
    // Two: the temporary file fits, the appending stream does not. Three:
    // everything fits.
    QTest::addColumn<int>("free");
    QTest::addColumn<bool>("intercepts");
    QTest::newRow("no room for the temporary file") << 1 << false;
    QTest::newRow("no room for the appending stream") << 2 << false;
    QTest::newRow("enough room") << 3 << true;
}

void StreamInterceptorTest::failedSetupLeavesStreamAlone()
{
    QFETCH(int, free);
    QFETCH(bool, intercepts);

    const QByteArray original = identity(STDERR_FILENO);
    QByteArray captured;
    QByteArray during;
    int availableBefore = -1;
    int availableAfter = -1;
    {
        DescriptorSqueeze squeeze(free);
        availableBefore = DescriptorSqueeze::available();
        {
            StreamInterceptor interceptor(stderr);
            during = identity(STDERR_FILENO);
            if (intercepts)
                writeRaw(STDERR_FILENO, "caught");
            captured = interceptor.streamReadAll();
        }
        // Every descriptor taken on the way is given back.
        availableAfter = DescriptorSqueeze::available();
    }
    QCOMPARE(availableBefore, free);
    QCOMPARE(availableAfter, free);
    QCOMPARE(identity(STDERR_FILENO), original);
    QCOMPARE(during == original, !intercepts);
    QCOMPARE(captured, intercepts ? QByteArray("caught") : QByteArray());
}

void StreamInterceptorTest::invalidStreams()
{
    // A stream whose descriptor is closed cannot be duplicated: the object
    // stays idle and its destruction puts nothing on that descriptor.
    FILE *broken = std::fopen("/dev/null", "w");
    QVERIFY(broken);
    const int fd = fileno(broken);
    ::close(fd);
    QByteArray captured("<unset>");
    bool descriptorStillClosed = false;
    {
        StreamInterceptor interceptor(broken);
        captured = interceptor.streamReadAll();
    }
    descriptorStillClosed = ::fcntl(fd, F_GETFD) == -1;
    std::fclose(broken);
    QCOMPARE(captured, QByteArray());
    QVERIFY(descriptorStillClosed);

    StreamInterceptor none(nullptr);
    QCOMPARE(none.streamReadAll(), QByteArray());
}

QTEST_GUILESS_MAIN(StreamInterceptorTest)
#include "tst_streaminterceptor.moc"
