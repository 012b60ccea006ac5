// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/regexphandler.h>

#include "systemtest.h"

#include <QRandomGenerator>
#include <QRegularExpression>
#include <QtTest>

#include <csignal>
#include <fcntl.h>
#include <poll.h>
#include <pwd.h>
#include <sys/prctl.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

// Handles "key = value" lines: the key of \a replacement ("key=value") gets
// the new value, or is deleted when the value is empty.
struct KeyValueHandler : RegExpHandler {
    explicit KeyValueHandler(const QString &replacement = QString(), const QByteArray &tail = QByteArray())
        : RegExpHandler(QStringLiteral("^(\\w+)\\s*=\\s*(.*)$"))
        , key(replacement.section(QLatin1Char('='), 0, 0))
        , value(replacement.section(QLatin1Char('='), 1).toUtf8())
        , appendTail(tail)
    {
    }
    bool handleRegExp(QByteArray *line) override
    {
        if (regExp().cap(1) != key)
            return false;
        *line = value.isEmpty() ? QByteArray() : key.toUtf8() + " = " + value;
        return !value.isEmpty();
    }
    bool finalHandleRegExp(QByteArray *tail) override
    {
        *tail = appendTail;
        return !appendTail.isNull();
    }
    const QString key;
    const QByteArray value;
    const QByteArray appendTail;
};

// Leaves every line as it is.
struct KeepHandler : RegExpHandler {
    KeepHandler()
        : RegExpHandler(QStringLiteral("="))
    {
    }
    bool handleRegExp(QByteArray *) override { return ++matches, false; }
    int matches = 0;
};

ino_t inode(const QString &file)
{
    struct stat st = {};
    return ::stat(QFile::encodeName(file).constData(), &st) == 0 ? st.st_ino : 0;
}

} // namespace

class RegExpHandlerTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<QTemporaryDir> _dir;
    QString path(const QString &name) const { return _dir->filePath(name); }
    // Every entry under the folder as "name=content" (byte for byte), "name/", "name=<symlink>" or
    // "name=<special>" (a pipe or a device).
    QStringList folderState() const
    {
        QStringList state;
        QDirIterator it(_dir->path(), QDir::AllEntries | QDir::NoDotAndDotDot | QDir::Hidden | QDir::System,
                        QDirIterator::Subdirectories);
        while (it.hasNext()) {
            const QFileInfo info(it.next());
            const QString name = QDir(_dir->path()).relativeFilePath(info.filePath());
            state << (info.isSymLink() ? name + QStringLiteral("=<symlink>")
                      : info.isDir()   ? name + QLatin1Char('/')
                      : !info.isFile() ? name + QStringLiteral("=<special>")
                                       : name + QLatin1Char('=') + QString::fromLatin1(readFile(info.filePath())));
        }
        state.sort();
        return state;
    }

private Q_SLOTS:
    void init() { _dir.reset(new QTemporaryDir); }

    void rewriteContent_data()
    {
        QTest::addColumn<QByteArray>("input");
        QTest::addColumn<QString>("replace"); // "key=new value"
        QTest::addColumn<QByteArray>("tail"); // null: nothing appended
        QTest::addColumn<QByteArray>("expected");

        const QByteArray untouched("# a comment\r\n\n   \t \n\tfoo bar baz\r\n#key = 1\nkey = v  # kept\r\n"
                                   "\xff\xfe not utf-8 = \x80\n" "nul\0byte = 1\n" "\0\0\0\n" "trailing = blank   ", 106);
        QTest::newRow("untouched lines are copied byte for byte") << untouched << QString() << QByteArray() << untouched;
        // A hash inside quotes starts the comment all the same.
        QTest::newRow("replaced lines: comment back after a tab, LF ending")
            << QByteArray("key = 1\nother = 2\r\n  key = \"3#a\"   # b  \r\n") << "key=x" << QByteArray()
            << QByteArray("key = x\nother = 2\r\nkey = x\t#a\"   # b\n");
        QTest::newRow("emptied line is removed with its comment")
            << QByteArray("a = 1\nkill = x # gone too\nb = 2\n") << "kill=" << QByteArray() << QByteArray("a = 1\nb = 2\n");
        QTest::newRow("tail written as it stands, even after an unterminated line")
            << QByteArray("a = 1") << QString() << QByteArray("b = 2\nc = 3") << QByteArray("a = 1b = 2\nc = 3");
        QTest::newRow("comment after a NUL byte is not seen, non-UTF-8 comment is decoded")
            << QByteArray("key = old\0 # hidden\n", 20) + "key = old # caf\xe9\n" << "key=new" << QByteArray()
            << QByteArray("key = new\nkey = new\t# caf\xef\xbf\xbd\n");
    }

    void rewriteContent()
    {
        QFETCH(QByteArray, input);
        QFETCH(QString, replace);
        QFETCH(QByteArray, tail);
        QFETCH(QByteArray, expected);

        const QString file = path(QStringLiteral("test.conf"));
        QVERIFY(writeFile(file, input));
        KeyValueHandler handler(replace, tail);
        QString error;
        QVERIFY2(RegExpHandler::rewriteSystemConfigureFile(file, handler, error, false), qPrintable(error));
        // No work copy is left and no backup made.
        QCOMPARE(folderState(), QStringList{"test.conf=" + QString::fromLatin1(expected)});
    }

    void matchingAgreesWithQRegExp()
    {
        // Lines are selected quickly for common expressions; whatever the route,
        // the handler must see exactly the matches QRegExp itself finds in the
        // text before the comment.
        struct MatchRecorder : RegExpHandler {
            using RegExpHandler::RegExpHandler;
            bool handleRegExp(QByteArray *) override { return matches << regExp().cap(0), false; }
            QStringList matches;
        };

        // Some of them outside the common subset.
        const QStringList patterns{"^(\\w+)\\s*=\\s*(.*)$", "a|^b", "^$", "x*", "((a)*)*b", ".{2,3}=", "[^=]+=[^=]*$",
                                   "e$|^k", "[k-y0]+\\S", "\\W\\d?[.=]", "[^ ]{,2}", "\\bk", "(?=a)", "(k|e)(y|=){1,3}"};
        QRandomGenerator random(20240611);

        static const char alphabet[] = "abkey=019 -_.\tAB";
        const QString file = path(QStringLiteral("agree.conf"));
        for (const QString &pattern : qAsConst(patterns)) {
            QByteArray content;
            QStringList expected;
            QRegExp reference(pattern, Qt::CaseSensitive, QRegExp::RegExp);
            for (int line = 0; line < 400; ++line) {
                QByteArray text;
                for (int k = 0, length = int(random.bounded(13)); k < length; ++k)
                    text += alphabet[random.bounded(int(sizeof alphabet - 1))];
                if (random.bounded(10) == 0) // some lines take the decoding route; Unicode blanks are trimmed too
                    text = "\xc2\xa0\xc3\xa9" + text + "\xe2\x80\x83";
                if (random.bounded(20) == 0) // the text ends at a NUL byte
                    text += '\0' + text;
                if (random.bounded(6) == 0)
                    text += " # note";
                content += text + '\n';
                const QString candidate = QString::fromUtf8(text).section(QLatin1Char('#'), 0, 0).trimmed();
                if (!candidate.isEmpty() && reference.indexIn(candidate) != -1)
                    expected << reference.cap(0);
            }
            QVERIFY(writeFile(file, content));
            MatchRecorder recorder(pattern);
            QString error;
            QVERIFY(RegExpHandler::readSystemConfigureFile(file, recorder, error));
            QVERIFY2(recorder.matches == expected, qPrintable(QStringLiteral("pattern %1: %2 matches, %3 expected")
                                                                  .arg(pattern).arg(recorder.matches.size()).arg(expected.size())));
        }
    }

    void rewriteKeepsFileIdentityAndBackup()
    {
        // Blanks, quotes and shell syntax in the name reach cp as one argument.
        const QString file = path(QStringLiteral("my conf $HOME;`id` 'x'.conf"));
        const QByteArray native = QFile::encodeName(file);
        QVERIFY(writeFile(file, "key = 1\n") && writeFile(file + QStringLiteral(".bak"), "older backup\n"));
        QCOMPARE(::chmod(native.constData(), 0640), 0);
        if (const struct passwd *nobody = geteuid() == 0 ? getpwnam("nobody") : nullptr)
            QCOMPARE(::chown(native.constData(), nobody->pw_uid, nobody->pw_gid), 0);
        const auto identity = [&] {
            struct stat st = {};
            ::stat(native.constData(), &st);
            return QVector<qulonglong>{st.st_ino, st.st_mode, st.st_uid, st.st_gid};
        };
        const QVector<qulonglong> before = identity();

        QString error;
        KeyValueHandler handler(QStringLiteral("key=3"));
        QVERIFY2(RegExpHandler::rewriteSystemConfigureFile(file, handler, error, true), qPrintable(error));
        // An older backup is replaced.
        QCOMPARE(folderState(), (QStringList{"my conf $HOME;`id` 'x'.conf.bak=key = 1\n", "my conf $HOME;`id` 'x'.conf=key = 3\n"}));
        QCOMPARE(identity(), before); // inode, mode and owner
    }

    void interruptedRewrites()
    {
        // A child process rewrites a file of about 2 MB over and over (each
        // rewrite turns version A into B and back) and is killed, with the cp
        // it runs, at random moments, half of them aimed at the copy back.
        // After each kill the disk must hold a whole version (a file cut short
        // only beside its complete work copy), and the next rewrite must
        // settle what it finds into a whole version, in the same inode.
        QByteArray versionA;
        QByteArray versionB;
        const QByteArray comment = "# " + QByteArray(1000, 'x') + '\n';
        for (int i = 0; i < 2000; ++i) {
            versionA += "k" + QByteArray::number(i) + " = a\n" + comment;
            versionB += "k" + QByteArray::number(i) + " = b\n" + comment;
        }
        const QString file = path(QStringLiteral("kill.conf"));
        const QString work = file + QStringLiteral(".tmp");
        QVERIFY(writeFile(file, versionA));
        const ino_t fileInode = inode(file);

        // The copy back announces itself on a pipe before running the real cp.
        QTemporaryDir side;
        const QByteArray fifo = QFile::encodeName(side.filePath(QStringLiteral("copy-back")));
        QCOMPARE(::mkfifo(fifo.constData(), 0600), 0);
        const int announcements = ::open(fifo.constData(), O_RDWR | O_NONBLOCK | O_CLOEXEC);
        QVERIFY(announcements >= 0);
        FakePrograms fakes;
        fakes.add(QStringLiteral("cp"), "case \"$3\" in *.tmp) echo > \"" + fifo + "\" ;; esac\nexec /bin/cp \"$@\"");
        const auto drain = [&] {
            char buffer[256];
            while (::read(announcements, buffer, sizeof buffer) > 0) {
            }
        };

        // How long a copy back takes, so that the aimed kills fall anywhere in
        // it: the start of cp, its truncation of the file or its writing.
        const QString scratch = path(QStringLiteral("scratch"));
        QVERIFY(writeFile(scratch, versionB));
        QElapsedTimer copyClock;
        copyClock.start();
        QString error;
        QVERIFY(RegExpHandler::safeCopy(scratch, scratch + QStringLiteral("2"), error));
        const int copyBackUs = int(copyClock.nsecsElapsed() / 1000);
        QVERIFY(QFile::remove(scratch) && QFile::remove(scratch + QStringLiteral("2")));
        drain();

        // The cp of a killed child comes to this process, which waits for it.
        ::prctl(PR_SET_CHILD_SUBREAPER, 1);
        const auto notReaper = qScopeGuard([] { ::prctl(PR_SET_CHILD_SUBREAPER, 0); });
        QLoggingCategory::setFilterRules(QStringLiteral("kvt.system.warning=false"));
        const auto logAgain = qScopeGuard([] { QLoggingCategory::setFilterRules(QString()); });

#ifdef __SANITIZE_ADDRESS__
        const int defaultTrials = 80; // each child is several times slower
#else
        const int defaultTrials = 200;
#endif
        const int trials = qEnvironmentVariableIsSet("KVT_KILL_TRIALS") ? qEnvironmentVariableIntValue("KVT_KILL_TRIALS")
                                                                         : defaultTrials;
        QRandomGenerator random(20261123);
        qint64 toCopyBackUs = 0; // from the start of the child to its first copy back
        int cutShort = 0;
        int workWaiting = 0;
        QElapsedTimer clock;
        clock.start();
        for (int trial = 0; trial < trials; ++trial) {
            const bool aimed = trial % 2 == 0;
            drain();
            QProcess child;
            child.setProcessChannelMode(QProcess::ForwardedErrorChannel);
            QElapsedTimer started;
            started.start();
            child.start(QStringLiteral(KVT_REWRITE_LOOP), {file});
            QVERIFY(child.waitForStarted());
            if (aimed) {
                struct pollfd wait = {announcements, POLLIN, 0};
                QCOMPARE(::poll(&wait, 1, 30000), 1);
                if (toCopyBackUs == 0)
                    toCopyBackUs = started.nsecsElapsed() / 1000;
                QThread::usleep(random.bounded(copyBackUs + 1));
            } else {
                QThread::usleep(random.bounded(int(qMax<qint64>(2 * toCopyBackUs, 1000))));
            }
            const pid_t pid = pid_t(child.processId());
            ::kill(-pid, SIGKILL); // the group, cp included, once the child has made it
            ::kill(pid, SIGKILL);
            QVERIFY(child.waitForFinished());
            while (::waitpid(-pid, nullptr, 0) > 0) {
            }

            // What the kill left.
            const QByteArray content = readFile(file);
            const bool hasWork = QFile::exists(work);
            const QByteArray workContent = readFile(work);
            QVERIFY2(!hasWork || workContent == versionA || workContent == versionB,
                     qPrintable(QStringLiteral("trial %1: a work copy of %2 bytes").arg(trial).arg(workContent.size())));
            const bool whole = content == versionA || content == versionB;
            QVERIFY2(whole || (hasWork && workContent.startsWith(content)),
                     qPrintable(QStringLiteral("trial %1: the file holds %2 bytes and no complete copy is beside it")
                                    .arg(trial).arg(content.size())));
            QCOMPARE(QDir(_dir->path()).entryList(QDir::AllEntries | QDir::NoDotAndDotDot | QDir::Hidden | QDir::System)
                         .filter(QRegularExpression(QStringLiteral("^(?!kill\\.conf(\\.tmp)?$)"))),
                     QStringList());
            cutShort += !whole;
            workWaiting += whole && hasWork;

            // A read sees a whole version; the next rewrite settles it.
            KeepHandler reader;
            QVERIFY(RegExpHandler::readSystemConfigureFile(file, reader, error));
            QCOMPARE(reader.matches, 2000);
            KeepHandler keep;
            QVERIFY2(RegExpHandler::rewriteSystemConfigureFile(file, keep, error, false), qPrintable(error));
            const QByteArray settled = readFile(file);
            QVERIFY(whole ? settled == content || settled == workContent : settled == workContent);
            QVERIFY(!QFile::exists(work));
            QCOMPARE(inode(file), fileInode);
        }
        ::close(announcements);
        qInfo("%d kills (%d aimed at the copy back, which takes %d us) in %lld ms: the file was cut short beside its "
              "complete work copy %d times, a complete work copy waited %d times",
              trials, (trials + 1) / 2, copyBackUs, clock.elapsed(), cutShort, workWaiting);
    }

    void plantedWorkFile_data()
    {
        QTest::addColumn<QString>("kind");
        QTest::newRow("link to another file") << "symlink";
        QTest::newRow("dangling link") << "dangling";
        QTest::newRow("second name of another file") << "hardlink";
        QTest::newRow("pipe") << "fifo";
        QTest::newRow("folder") << "folder";
    }

    void plantedWorkFile()
    {
        // Whatever sits at the work name without being a file of our own is
        // neither written through nor removed, and nothing else changes.
        QFETCH(QString, kind);
        const QString file = path(QStringLiteral("f.conf"));
        const QString victim = path(QStringLiteral("victim"));
        const QByteArray work = QFile::encodeName(file + QStringLiteral(".tmp"));
        QVERIFY(writeFile(file, "key = old\n") && writeFile(victim, "precious\n"));
        const QByteArray target = QFile::encodeName(kind == QLatin1String("dangling") ? path(QStringLiteral("none")) : victim);
        if (kind == QLatin1String("symlink") || kind == QLatin1String("dangling"))
            QCOMPARE(::symlink(target.constData(), work.constData()), 0);
        else if (kind == QLatin1String("hardlink"))
            QCOMPARE(::link(target.constData(), work.constData()), 0);
        else if (kind == QLatin1String("fifo"))
            QCOMPARE(::mkfifo(work.constData(), 0600), 0);
        else
            QVERIFY(QDir().mkdir(QString::fromLocal8Bit(work)));
        const QStringList before = folderState();

        KeyValueHandler handler(QStringLiteral("key=new"));
        QString error;
        QVERIFY(!RegExpHandler::rewriteSystemConfigureFile(file, handler, error, true));
        QCOMPARE(error, QStringLiteral("\"%1\" is not a regular file of its own (a link, a device or another user's file); "
                                       "nothing was written through it").arg(QString::fromLocal8Bit(work)));
        QCOMPARE(folderState(), before);
    }

    void leftWorkCopy_data()
    {
        // A work copy found beside the file, and what a rewrite that leaves
        // the content alone makes of the two.
        QTest::addColumn<QByteArray>("file");
        QTest::addColumn<QByteArray>("work");
        QTest::addColumn<bool>("sameTime"); // the work copy carries the file's modification time
        QTest::addColumn<QByteArray>("result"); // null: refused, both stay

        QTest::newRow("finished rewrite") << QByteArray("a = 2\n") << QByteArray("a = 2\n") << false << QByteArray("a = 2\n");
        QTest::newRow("copy back cut short") << QByteArray("a = 2\nb") << QByteArray("a = 2\nb = 3\n") << false
                                             << QByteArray("a = 2\nb = 3\n");
        QTest::newRow("copy back not begun") << QByteArray("a = 1\n") << QByteArray("a = 2\n") << true << QByteArray("a = 2\n");
        QTest::newRow("file changed since") << QByteArray("a = 1\n") << QByteArray("a = 2\n") << false << QByteArray();
    }

    void leftWorkCopy()
    {
        QFETCH(QByteArray, file);
        QFETCH(QByteArray, work);
        QFETCH(bool, sameTime);
        QFETCH(QByteArray, result);

        const QString name = path(QStringLiteral("f.conf"));
        const QString workName = name + QStringLiteral(".tmp");
        QVERIFY(writeFile(name, file) && writeFile(workName, work));
        struct timespec times[2] = {{1000000000, 5}, {1000000000, 5}};
        QCOMPARE(::utimensat(AT_FDCWD, QFile::encodeName(name).constData(), times, 0), 0);
        times[1].tv_nsec = sameTime ? 5 : 6;
        QCOMPARE(::utimensat(AT_FDCWD, QFile::encodeName(workName).constData(), times, 0), 0);

        KeepHandler keep;
        QString error;
        QCOMPARE(RegExpHandler::rewriteSystemConfigureFile(name, keep, error, false), !result.isNull());
        if (result.isNull()) {
            QCOMPARE(error, QStringLiteral("\"%1\" holds a version of \"%2\" from a rewrite that was interrupted, and "
                                           "\"%2\" has changed since; keep the one you want and remove \"%1\"")
                                .arg(workName, name));
            QCOMPARE(folderState(), (QStringList{"f.conf.tmp=" + QString::fromLatin1(work), "f.conf=" + QString::fromLatin1(file)}));
        } else {
            QCOMPARE(folderState(), QStringList{"f.conf=" + QString::fromLatin1(result)});
        }
    }

    void optionLikeNames()
    {
        // Relative names beginning with "-" are files to cp, not options.
        const QString savedCurrent = QDir::currentPath();
        QVERIFY(QDir::setCurrent(_dir->path()));
        QVERIFY(writeFile(QStringLiteral("-a"), "key = 1\n"));
        QString error;
        const bool copied = RegExpHandler::safeCopy(QStringLiteral("-a"), QStringLiteral("-b"), error);
        KeyValueHandler handler(QStringLiteral("key=2"));
        const bool rewritten = RegExpHandler::rewriteSystemConfigureFile(QStringLiteral("-b"), handler, error, true);
        QVERIFY(QDir::setCurrent(savedCurrent));
        QVERIFY2(copied && rewritten, qPrintable(error));
        QCOMPARE(folderState(), (QStringList{"-a=key = 1\n", "-b.bak=key = 1\n", "-b=key = 2\n"}));
    }

    void failures_data()
    {
        // Each case optionally puts a fake cp first on PATH or limits the size
        // of the files this process writes, rewrites "f.conf" ("key = old\n",
        // key replaced by "new") with a backup, and checks the message against
        // a pattern and the exact folder state. A case that expects an empty
        // folder starts without "f.conf".
        QTest::addColumn<QByteArray>("fakeCp"); // null: the real cp
        QTest::addColumn<int>("sizeLimit"); // 0: none
        QTest::addColumn<QString>("messagePattern"); // FOLDER stands for the folder path
        QTest::addColumn<QStringList>("state");

        const QString cp = QStringLiteral("Process: \"cp --force --preserve=mode,ownership ");
        const QString copyBack = "^" + QRegularExpression::escape(cp + "FOLDER/f.conf.tmp FOLDER/f.conf\"");
        const QString old = QStringLiteral("f.conf=key = old\n");

        QTest::newRow("missing file") << QByteArray() << 0 << "^\"FOLDER/f\\.conf\" not exists$" << QStringList();
        // Nothing incomplete is ever copied over the file, nor left behind.
        QTest::newRow("work copy cannot be written completely")
            << QByteArray() << 4 << "^\"FOLDER/f\\.conf\\.tmp\" error 2\nFile too large$" << QStringList{old};
        // cp may have stopped half-way: the complete work copy stays.
        QTest::newRow("copy back fails, message trimmed")
            << QByteArray("printf '\\n  cp: disk on fire  \\n\\n' >&2\nexit 3") << 0
            << copyBack + "\\. Exit code: 3\\.\n\"cp: disk on fire\"$"
            << QStringList{old, "f.conf.bak=key = old\n", "f.conf.tmp=key = new\n"};
    }

    void failures()
    {
        QFETCH(QByteArray, fakeCp);
        QFETCH(int, sizeLimit);
        QFETCH(QString, messagePattern);
        QFETCH(QStringList, state);

        const QString file = path(QStringLiteral("f.conf"));
        if (!state.isEmpty())
            QVERIFY(writeFile(file, "key = old\n"));

        FakePrograms fakes;
        if (!fakeCp.isNull())
            fakes.add(QStringLiteral("cp"), fakeCp);
        struct rlimit saved = {};
        ::getrlimit(RLIMIT_FSIZE, &saved);
        if (sizeLimit > 0) {
            ::signal(SIGXFSZ, SIG_IGN);
            const struct rlimit limit = {rlim_t(sizeLimit), saved.rlim_max};
            ::setrlimit(RLIMIT_FSIZE, &limit);
        }
        KeyValueHandler handler(QStringLiteral("key=new"));
        QString error = QStringLiteral("earlier");
        const bool rewritten = RegExpHandler::rewriteSystemConfigureFile(file, handler, error, true);
        ::setrlimit(RLIMIT_FSIZE, &saved);
        QVERIFY(!rewritten);

        // The message follows the earlier text on a line of its own.
        const QRegularExpression re(messagePattern.replace(0, 1, QStringLiteral("^earlier\n"))
                                        .replace(QLatin1String("FOLDER"), QRegularExpression::escape(_dir->path())));
        QVERIFY2(re.match(error).hasMatch(), qPrintable(error));
        state.sort();
        QCOMPARE(folderState(), state);
    }
};

QTEST_GUILESS_MAIN(RegExpHandlerTest)
#include "tst_regexphandler.moc"
