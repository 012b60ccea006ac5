// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/streaminterceptor.h>

#include <QFile>
#include <QtTest>

#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
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

} // namespace

class StreamInterceptorTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void capturesEverything_data()
    {
        QTest::addColumn<FILE *>("stream");
        QTest::newRow("standard output") << stdout;
        QTest::newRow("standard error") << stderr;
    }

    void capturesEverything()
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
        QCOMPARE(inner + ' ' + afterInner + ' ' + identity(fd), "nested " + outerIdentity + ' ' + before);
        const QByteArray expected = "stdio 42;raw write;child;" + big;
        QVERIFY2(first == expected, first.left(80).constData());
        // Reading consumes nothing: the second read starts from the beginning.
        QVERIFY(second == expected + "end");
    }

    void invalidStreams()
    {
        // A closed descriptor cannot be duplicated: the object stays idle and its
        // destruction puts nothing on that descriptor.
        FILE *broken = std::fopen("/dev/null", "w");
        const int fd = fileno(broken);
        ::close(fd);
        const QByteArray captured = StreamInterceptor(broken).streamReadAll();
        const bool stillClosed = ::fcntl(fd, F_GETFD) == -1;
        std::fclose(broken);
        QVERIFY(captured.isEmpty() && stillClosed && StreamInterceptor(nullptr).streamReadAll().isEmpty());
    }
};

QTEST_GUILESS_MAIN(StreamInterceptorTest)
#include "tst_streaminterceptor.moc"
