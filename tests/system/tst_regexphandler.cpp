#include <kvt-common/regexphandler.h>

#include "fakeprograms.h"

#include <QDir>
#include <QFileInfo>
#include <QRandomGenerator>
#include <QRegularExpression>
#include <QtTest>

#include <grp.h>
#include <pwd.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

// Handles "key = value" lines: keys listed in `replace` get a new value and
// return true, keys in `remove` are emptied, keys in `rewriteRaw` get raw
// bytes and return false; every call is recorded as "key=value" (or with a
// leading "null:" when called by a read).
class KeyValueHandler : public RegExpHandler
{
public:
    KeyValueHandler()
        : RegExpHandler(QStringLiteral("^(\\w+)\\s*=\\s*(.*)$"))
    {
    }

    bool handleRegExp(QByteArray *line) override
    {
        const QString key = regExp().cap(1);
        calls << (line ? QString() : QStringLiteral("null:")) + key + QLatin1Char('=') + regExp().cap(2).trimmed();
        if (!line)
            return false;
        if (replace.contains(key)) {
            *line = key.toUtf8() + " = " + replace.value(key);
            return true;
        }
        if (remove.contains(key)) {
            line->clear();
            return false;
        }
        if (rewriteRaw.contains(key)) {
            *line = rewriteRaw.value(key);
            return false;
        }
        return false;
    }

    bool finalHandleRegExp(QByteArray *tail) override
    {
        tailWasEmpty = tail && tail->isEmpty();
        if (appendTail.isNull())
            return false;
        *tail = appendTail;
        return true;
    }

    QHash<QString, QByteArray> replace;
    QHash<QString, QByteArray> rewriteRaw;
    QStringList remove;
    QByteArray appendTail; // null: finalHandleRegExp returns false
    QStringList calls;
    bool tailWasEmpty = false;
};

// Overrides nothing but the pure function, so the base finalHandleRegExp runs.
class MinimalHandler : public RegExpHandler
{
public:
    MinimalHandler()
        : RegExpHandler(QStringLiteral("^option\\s+(\\S+)"))
    {
    }
    bool handleRegExp(QByteArray *line) override
    {
        if (line)
            *line = "option changed";
        return true;
    }
};

QByteArray readAll(const QString &path)
{
    QFile f(path);
    if (!f.open(QIODevice::ReadOnly))
        return QByteArray("<unreadable>");
    return f.readAll();
}

bool writeAll(const QString &path, const QByteArray &content)
{
    QFile f(path);
    if (!f.open(QIODevice::WriteOnly | QIODevice::Truncate))
        return false;
    return f.write(content) == content.size();
}

} // namespace

class RegExpHandlerTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();

    void rewriteContent_data();
    void rewriteContent();
    void rewriteWithoutOverrides();
    void readCallsHandlerForEveryMatch();
    void handlerMayChangeExpressionBetweenLines();
    void matchingAgreesWithQRegExp();
    void rewriteKeepsInodeModeAndOwner();
    void backupHandling();
    void oddFileNamesReachCpUnchanged();

    void missingFile_data();
    void missingFile();
    void failures_data();
    void failures();
    void safeCopyMessages();

private:
    QString path(const QString &name) const { return _dir->filePath(name); }
    QStringList listing() const;

    std::unique_ptr<QTemporaryDir> _dir;
};

void RegExpHandlerTest::init()
{
    _dir.reset(new QTemporaryDir);
    QVERIFY(_dir->isValid());
}

void RegExpHandlerTest::cleanup()
{
    _dir.reset();
}

// The folder's entries, directories marked with a trailing '/'.
QStringList RegExpHandlerTest::listing() const
{
    QStringList names;
    const QFileInfoList entries = QDir(_dir->path()).entryInfoList(QDir::AllEntries | QDir::NoDotAndDotDot | QDir::Hidden,
                                                                   QDir::Name);
    for (const QFileInfo &info : entries)
        names << info.fileName() + (info.isDir() ? QStringLiteral("/") : QString());
    return names;
}

void RegExpHandlerTest::rewriteContent_data()
{
    QTest::addColumn<QByteArray>("input");
    QTest::addColumn<QStringList>("replace");   // "key=new value"
    QTest::addColumn<QStringList>("remove");
    QTest::addColumn<QByteArray>("tail");       // null: nothing appended
    QTest::addColumn<QByteArray>("expected");

    const QByteArray untouched("# a comment\r\n\n   \t \n\tfoo bar baz\r\n#key = 1\nkey = v  # kept\r\n"
                               "\xff\xfe not utf-8 = \x80\n" "nul\0byte = 1\n" "\0\0\0\n"
                               "trailing = blank   \n", 107);
    QTest::newRow("untouched lines are copied byte for byte")
        << untouched << QStringList() << QStringList() << QByteArray() << untouched;
    QTest::newRow("replaced line gets its comment back after a tab")
        << QByteArray("key = old  #note\n") << QStringList{"key=new"} << QStringList() << QByteArray()
        << QByteArray("key = new\t#note\n");
    QTest::newRow("replaced line without comment has no tab")
        << QByteArray("key = old\n") << QStringList{"key=new"} << QStringList() << QByteArray()
        << QByteArray("key = new\n");
    QTest::newRow("empty comment is not put back")
        << QByteArray("key = old #\t \n") << QStringList{"key=new"} << QStringList() << QByteArray()
        << QByteArray("key = new\t#\n");
    QTest::newRow("comment is trimmed, inner hashes kept")
        << QByteArray("key = old   # a # b  \r\n") << QStringList{"key=new"} << QStringList() << QByteArray()
        << QByteArray("key = new\t# a # b\n");
    QTest::newRow("hash inside quotes starts a comment")
        << QByteArray("key = \"a#b\"\n") << QStringList{"key=new"} << QStringList() << QByteArray()
        << QByteArray("key = new\t#b\"\n");
    QTest::newRow("replaced CRLF line ends with LF")
        << QByteArray("a = 1\r\nkey = old\r\nb = 2\r\n") << QStringList{"key=new"} << QStringList() << QByteArray()
        << QByteArray("a = 1\r\nkey = new\nb = 2\r\n");
    QTest::newRow("indented key matches, replacement is the handler's")
        << QByteArray("   key = old\n") << QStringList{"key=new"} << QStringList() << QByteArray()
        << QByteArray("key = new\n");
    QTest::newRow("several matches all replaced")
        << QByteArray("key = 1\nother = 2\nkey = 3 # third\n") << QStringList{"key=x"} << QStringList() << QByteArray()
        << QByteArray("key = x\nother = 2\nkey = x\t# third\n");
    QTest::newRow("emptied line is removed")
        << QByteArray("a = 1\nkill = x # gone too\nb = 2\n") << QStringList() << QStringList{"kill"} << QByteArray()
        << QByteArray("a = 1\nb = 2\n");
    QTest::newRow("last line without terminator stays so")
        << QByteArray("a = 1\nkey = v") << QStringList() << QStringList() << QByteArray()
        << QByteArray("a = 1\nkey = v");
    QTest::newRow("replaced last line gains a terminator")
        << QByteArray("a = 1\nkey = v") << QStringList{"key=w"} << QStringList() << QByteArray()
        << QByteArray("a = 1\nkey = w\n");
    QTest::newRow("tail written as it stands")
        << QByteArray("a = 1\n") << QStringList() << QStringList() << QByteArray("new = 1\nmore = 2")
        << QByteArray("a = 1\nnew = 1\nmore = 2");
    QTest::newRow("tail after a last line without terminator is the handler's affair")
        << QByteArray("a = 1") << QStringList() << QStringList() << QByteArray("b = 2\n")
        << QByteArray("a = 1b = 2\n");
    QTest::newRow("empty file, tail only")
        << QByteArray() << QStringList() << QStringList() << QByteArray("first = 1\n") << QByteArray("first = 1\n");
    QTest::newRow("empty file stays empty") << QByteArray() << QStringList() << QStringList() << QByteArray()
                                            << QByteArray();
    QTest::newRow("comment after a NUL byte is not seen")
        << QByteArray("key = old\0 # hidden\n", 20) << QStringList{"key=new"} << QStringList() << QByteArray()
        << QByteArray("key = new\n");
    QTest::newRow("non-ASCII value, comment put back")
        << QByteArray("key = \xd0\xb4\xd0\xb0 # \xd0\xbd\xd0\xb5\xd1\x82\n") << QStringList{"key=new"} << QStringList()
        << QByteArray() << QByteArray("key = new\t# \xd0\xbd\xd0\xb5\xd1\x82\n");
    QTest::newRow("non-UTF-8 comment survives a replacement")
        << QByteArray("key = old # caf\xe9\n") << QStringList{"key=new"} << QStringList() << QByteArray()
        << QByteArray("key = new\t# caf\xef\xbf\xbd\n");

    const QByteArray longValue(1024 * 1024, 'v');
    const QByteArray longComment = "# " + QByteArray(1024 * 1024, 'c') + "\r\n";
    QTest::newRow("1 MiB lines, one kept and one replaced")
        << QByteArray(longComment + "big = " + longValue + "\nhuge = " + longValue + "\n")
        << QStringList{"huge=small"} << QStringList() << QByteArray()
        << QByteArray(longComment + "big = " + longValue + "\nhuge = small\n");
}

void RegExpHandlerTest::rewriteContent()
{
    QFETCH(QByteArray, input);
    QFETCH(QStringList, replace);
    QFETCH(QStringList, remove);
    QFETCH(QByteArray, tail);
    QFETCH(QByteArray, expected);

    const QString file = path(QStringLiteral("test.conf"));
    QVERIFY(writeAll(file, input));

    KeyValueHandler handler;
    for (const QString &r : replace)
        handler.replace.insert(r.section(QLatin1Char('='), 0, 0), r.section(QLatin1Char('='), 1).toUtf8());
    handler.remove = remove;
    handler.appendTail = tail;

    QString error;
    QVERIFY2(RegExpHandler::rewriteSystemConfigureFile(file, handler, error, false), qPrintable(error));
    QCOMPARE(error, QString());
    const QByteArray result = readAll(file);
    if (result.size() > 4096)
        QVERIFY2(result == expected, "large content differs");
    else
        QCOMPARE(result, expected);
    QVERIFY(handler.tailWasEmpty);
    // Only the file itself is left: the work copy is gone and no backup made.
    QCOMPARE(listing(), QStringList{"test.conf"});
}

void RegExpHandlerTest::rewriteWithoutOverrides()
{
    const QString file = path(QStringLiteral("min.conf"));
    QVERIFY(writeAll(file, "# option commented\noption old # why\nother\n"));
    MinimalHandler handler;
    QString error;
    QVERIFY(RegExpHandler::rewriteSystemConfigureFile(file, handler, error, false));
    // The base finalHandleRegExp appends nothing.
    QCOMPARE(readAll(file), QByteArray("# option commented\noption changed\t# why\nother\n"));
}

void RegExpHandlerTest::readCallsHandlerForEveryMatch()
{
    const QString file = path(QStringLiteral("read.conf"));
    // Unicode blanks around the text are trimmed like ASCII ones; the text
    // ends at a NUL byte.
    const QByteArray content("a = 1\n#b = 2\n  c = 3 # x\nnot matching\n\n  # d = 4\ne=5\r\nf = \"6#7\"\n"
                             "\xc2\xa0h = 8\xc2\xa0# nbsp\n" "i\0 = 9\n" "\xe2\x80\x83j = 10\t\xe2\x80\x83\n"
                             "k = 11\0# after nul\n" "g = last", 128);
    QVERIFY(writeAll(file, content));
    KeyValueHandler handler;
    handler.replace.insert(QStringLiteral("a"), "changed");
    QString error = QStringLiteral("earlier");
    QVERIFY(RegExpHandler::readSystemConfigureFile(file, handler, error));
    QCOMPARE(handler.calls, (QStringList{"null:a=1", "null:c=3", "null:e=5", "null:f=\"6", "null:h=8", "null:j=10", "null:k=11",
                                     "null:g=last"}));
    QCOMPARE(error, QStringLiteral("earlier"));
    // A read changes nothing on disk.
    QCOMPARE(readAll(file), content);
    QCOMPARE(listing(), QStringList{"read.conf"});
}

void RegExpHandlerTest::handlerMayChangeExpressionBetweenLines()
{
    // A handler that switches to a section's own expression after its header.
    class SectionHandler : public RegExpHandler
    {
    public:
        SectionHandler()
            : RegExpHandler(QStringLiteral("^\\[(\\w+)\\]$"))
        {
        }
        bool handleRegExp(QByteArray *line) override
        {
            seen << regExp().cap(1);
            if (regExp().pattern().startsWith(QLatin1String("^\\[")))
                regExp().setPattern(QStringLiteral("^port\\s+(\\d+)"));
            else if (line)
                *line = "port 1";
            return line && !seen.last().startsWith(QLatin1Char('s'));
        }
        QStringList seen;
    } handler;

    const QString file = path(QStringLiteral("s.conf"));
    QVERIFY(writeAll(file, "port 7\n[server]\nport 8\n"));
    QString error;
    QVERIFY(RegExpHandler::rewriteSystemConfigureFile(file, handler, error, false));
    QCOMPARE(handler.seen, (QStringList{"server", "8"}));
    QCOMPARE(readAll(file), QByteArray("port 7\n[server]\nport 1\n"));
}

namespace {

// Records the whole match of every call.
class MatchRecorder : public RegExpHandler
{
public:
    explicit MatchRecorder(const QString &pattern)
        : RegExpHandler(pattern)
    {
    }
    bool handleRegExp(QByteArray *) override
    {
        matches << regExp().cap(0);
        return false;
    }
    QStringList matches;
};

QString randomPattern(QRandomGenerator &random, int depth)
{
    static const char *const atoms[] = {"a", "b", "k", "e", "y", "=", "0", "1", " ", "-", "_", ".", "\\.",
                                        "\\-", "\\=", "\\d", "\\D", "\\s", "\\S", "\\w", "\\W",
                                        "[a-c]", "[^=]", "[0-9_]", "[.=]", "[^ ]", "[k-y0]", "^", "$",
                                        // outside the common subset
                                        "\\b", "[[:alpha:]]", "(?=a)", "\\x41"};
    static const char *const quantifiers[] = {"", "", "", "*", "+", "?", "{2}", "{1,3}", "{0,}", "{2,}", "{,2}", "*?"};
    QString pattern;
    const int pieces = 1 + int(random.bounded(4));
    for (int i = 0; i < pieces; ++i) {
        if (depth < 2 && random.bounded(4) == 0) {
            pattern += random.bounded(2) ? QStringLiteral("(") : QStringLiteral("(?:");
            pattern += randomPattern(random, depth + 1);
            if (random.bounded(2))
                pattern += QLatin1Char('|') + randomPattern(random, depth + 1);
            pattern += QLatin1Char(')');
        } else {
            pattern += QLatin1String(atoms[random.bounded(int(sizeof atoms / sizeof *atoms))]);
        }
        pattern += QLatin1String(quantifiers[random.bounded(int(sizeof quantifiers / sizeof *quantifiers))]);
    }
    if (depth == 0 && random.bounded(5) == 0)
        pattern += QLatin1Char('|') + randomPattern(random, 1);
    return pattern;
}

} // namespace

void RegExpHandlerTest::matchingAgreesWithQRegExp()
{
    // Lines are selected quickly for common expressions; whatever the route,
    // the handler must see exactly the lines (and matches) that QRegExp
    // itself finds in the text before the comment.
    QStringList patterns{"^(\\w+)\\s*=\\s*(.*)$", "^(key\\d*[02468]00)\\s*=", "a|^b", "$", "^$", "^", "x*",
                         "(a|)+b", "((a)*)*b", ".{2,3}=", "[^=]+=[^=]*$", "a{0}b", "(?:ab){2,}", "e$|^k", "=\\s+$"};
    QRandomGenerator random(20240611);
    for (int i = 0; i < 400; ++i)
        patterns << randomPattern(random, 0);

    static const char alphabet[] = "abkey=019 -_.\tAB";
    const QString file = path(QStringLiteral("agree.conf"));
    for (const QString &pattern : qAsConst(patterns)) {
        QByteArray content;
        QStringList texts;
        for (int line = 0; line < 60; ++line) {
            QByteArray text;
            const int length = int(random.bounded(13));
            for (int k = 0; k < length; ++k)
                text += alphabet[random.bounded(int(sizeof alphabet - 1))];
            if (random.bounded(15) == 0)
                text += "\xc3\xa9" + text; // some lines take the decoding route
            if (random.bounded(6) == 0)
                text += " # note";
            content += text + '\n';
            texts << QString::fromUtf8(text).section(QLatin1Char('#'), 0, 0).trimmed();
        }
        QVERIFY(writeAll(file, content));

        QRegExp reference(pattern, Qt::CaseSensitive, QRegExp::RegExp);
        QStringList expected;
        for (const QString &text : qAsConst(texts)) {
            if (!text.isEmpty() && reference.indexIn(text, 0) != -1)
                expected << reference.cap(0);
        }
        MatchRecorder recorder(pattern);
        QString error;
        QVERIFY(RegExpHandler::readSystemConfigureFile(file, recorder, error));
        QVERIFY2(recorder.matches == expected, qPrintable(QStringLiteral("pattern %1: %2 matches, %3 expected")
                                                              .arg(pattern).arg(recorder.matches.size()).arg(expected.size())));
    }
}

void RegExpHandlerTest::rewriteKeepsInodeModeAndOwner()
{
    if (geteuid() != 0)
        QSKIP("giving a file to another user needs root");
    const struct passwd *nobody = getpwnam("nobody");
    if (!nobody)
        QSKIP("there is no user 'nobody' on this machine");

    const QString file = path(QStringLiteral("owned.conf"));
    QVERIFY(writeAll(file, "key = old\n"));
    const QByteArray native = QFile::encodeName(file);
    QCOMPARE(::chown(native.constData(), nobody->pw_uid, nobody->pw_gid), 0);
    QCOMPARE(::chmod(native.constData(), 0640), 0);
    struct stat before;
    QCOMPARE(::stat(native.constData(), &before), 0);

    KeyValueHandler handler;
    handler.replace.insert(QStringLiteral("key"), "new");
    QString error;
    QVERIFY2(RegExpHandler::rewriteSystemConfigureFile(file, handler, error, true), qPrintable(error));

    struct stat after;
    QCOMPARE(::stat(native.constData(), &after), 0);
    QCOMPARE(readAll(file), QByteArray("key = new\n"));
    QCOMPARE(after.st_ino, before.st_ino);
    QCOMPARE(after.st_mode & 07777, mode_t(0640));
    QCOMPARE(after.st_uid, nobody->pw_uid);
    QCOMPARE(after.st_gid, nobody->pw_gid);
    QCOMPARE(listing(), (QStringList{"owned.conf", "owned.conf.bak"}));
    QCOMPARE(readAll(file + QStringLiteral(".bak")), QByteArray("key = old\n"));
}

void RegExpHandlerTest::backupHandling()
{
    const QString file = path(QStringLiteral("b.conf"));
    const QString bak = file + QStringLiteral(".bak");
    QVERIFY(writeAll(file, "key = 1\n"));
    QVERIFY(writeAll(bak, "older backup\n"));

    KeyValueHandler handler;
    handler.replace.insert(QStringLiteral("key"), "2");
    QString error;
    QVERIFY(RegExpHandler::rewriteSystemConfigureFile(file, handler, error, false));
    QCOMPARE(readAll(bak), QByteArray("older backup\n"));

    handler.replace.insert(QStringLiteral("key"), "3");
    QVERIFY(RegExpHandler::rewriteSystemConfigureFile(file, handler, error, true));
    QCOMPARE(readAll(bak), QByteArray("key = 2\n"));
    QCOMPARE(readAll(file), QByteArray("key = 3\n"));
    QCOMPARE(error, QString());
    QCOMPARE(listing(), (QStringList{"b.conf", "b.conf.bak"}));
}

void RegExpHandlerTest::oddFileNamesReachCpUnchanged()
{
    // Blanks, quotes and shell syntax in the name: cp gets it as one argument.
    const QString file = path(QStringLiteral("my conf $HOME;`id` 'x'.conf"));
    QVERIFY(writeAll(file, "key = 1\n"));
    KeyValueHandler handler;
    handler.replace.insert(QStringLiteral("key"), "2");
    QString error;
    QVERIFY2(RegExpHandler::rewriteSystemConfigureFile(file, handler, error, true), qPrintable(error));
    QCOMPARE(readAll(file), QByteArray("key = 2\n"));
    QCOMPARE(listing(), (QStringList{"my conf $HOME;`id` 'x'.conf", "my conf $HOME;`id` 'x'.conf.bak"}));
}

void RegExpHandlerTest::missingFile_data()
{
    QTest::addColumn<QString>("name");
    QTest::addColumn<bool>("rewrite");
    QTest::addColumn<QString>("previousError");

    QTest::newRow("read, no earlier message") << "absent.conf" << false << QString();
    QTest::newRow("rewrite, no earlier message") << "absent.conf" << true << QString();
    QTest::newRow("rewrite after an earlier message") << "absent.conf" << true << "first failure";
    QTest::newRow("folder is a regular file") << "plain/inside.conf" << true << QString();
}

void RegExpHandlerTest::missingFile()
{
    QFETCH(QString, name);
    QFETCH(bool, rewrite);
    QFETCH(QString, previousError);

    QVERIFY(writeAll(path(QStringLiteral("plain")), "x\n"));
    const QString file = path(name);
    KeyValueHandler handler;
    QString error = previousError;
    const bool ok = rewrite ? RegExpHandler::rewriteSystemConfigureFile(file, handler, error, true)
                            : RegExpHandler::readSystemConfigureFile(file, handler, error);
    QVERIFY(!ok);
    const QString message = QStringLiteral("\"%1\" not exists").arg(file);
    QCOMPARE(error, previousError.isEmpty() ? message : previousError + QLatin1Char('\n') + message);
    QVERIFY(handler.calls.isEmpty());
    // Neither a work copy nor a backup appears.
    QCOMPARE(listing(), QStringList{"plain"});
}

void RegExpHandlerTest::failures_data()
{
    // Each case prepares the folder, optionally puts a fake cp first on PATH,
    // runs a rewrite of "f.conf" (content "key = old\n", key replaced by
    // "new") and checks the message against a pattern and the exact state of
    // the folder afterwards.
    QTest::addColumn<QString>("setup");      // "dir": f.conf is a folder; "staleWorkDir"; "bakDir"
    QTest::addColumn<QByteArray>("fakeCp");  // null: the real cp; "none": no cp at all
    QTest::addColumn<bool>("backup");
    QTest::addColumn<QString>("messagePattern"); // %F is replaced by the folder path
    QTest::addColumn<QStringList>("state");      // "name=content" or "name/"

    const QString cpArgs = QStringLiteral("cp --force --preserve=mode,ownership");
    const QString first = QRegularExpression::escape(cpArgs + " %F/f.conf %F/f.conf.tmp");
    const QString second = QRegularExpression::escape(cpArgs + " %F/f.conf.tmp %F/f.conf");
    // Calls the real cp, then damages something depending on which copy it is.
    const auto sabotage = [](const char *onFirst, const char *onSecond) {
        return QByteArray("/bin/cp \"$@\" || exit $?\ncase \"$3\" in *.tmp) ") + onSecond
               + QByteArray(" ;; *) ") + onFirst + QByteArray(" ;; esac\nexit 0");
    };

    QTest::newRow("target is a folder")
        << "dir" << QByteArray() << false
        << QString("^Process: \"" + first + "\"\\. Exit code: 1\\.\n\"[^\n]*cp: [^\n]+\"$")
        << QStringList{"f.conf/"};
    QTest::newRow("cp not found")
        << "" << QByteArray("none") << true
        << QString("^Process: \"" + first + "\"\\. Error: [^\n]+\\.\n\"Not started\"$")
        << QStringList{"f.conf=key = old\n"};
    QTest::newRow("cp crashes")
        << "" << QByteArray("kill -SEGV $$") << true
        << QString("^Process: \"" + first + "\"\\. Error: [^\n]+\\.\n\"Not finished\"$")
        << QStringList{"f.conf=key = old\n"};
    QTest::newRow("cp fails, message trimmed")
        << "" << QByteArray("printf '\\n  cp: disk on fire  \\n\\n' >&2\nexit 3") << true
        << QString("^Process: \"" + first + "\"\\. Exit code: 3\\.\n\"cp: disk on fire\"$")
        << QStringList{"f.conf=key = old\n"};
    QTest::newRow("target turned into a folder after the work copy")
        << "" << sabotage("rm -f \"$3\"; mkdir \"$3\"", ":") << true
        << QString("^\"%F/f\\.conf\" error 5\nfile to open is a directory$")
        << QStringList{"f.conf/", "f.conf.tmp=key = old\n"};
    QTest::newRow("stale work folder")
        << "staleWorkDir" << QByteArray() << true
        << QString("^\"%F/f\\.conf\\.tmp\" error 5\n[^\n]+$")
        << QStringList{"f.conf=key = old\n", "f.conf.tmp/", "f.conf.tmp/f.conf=key = old\n"};
    QTest::newRow("work copy cannot be written completely")
        << "" << sabotage("rm -f \"$4\"; ln -s /dev/full \"$4\"", ":") << true
        << QString("^\"%F/f\\.conf\\.tmp\" error \\d+\nNo space left on device$")
        << QStringList{"f.conf=key = old\n", "f.conf.tmp=<symlink>"};
    QTest::newRow("backup cannot replace a folder")
        << "bakDir" << QByteArray() << true
        << QString("^\"%F/f\\.conf\" error \\d+\n[^\n]+$")
        << QStringList{"f.conf=key = old\n", "f.conf.bak/", "f.conf.bak/keep=x", "f.conf.tmp=key = new\n"};
    QTest::newRow("backup folder ignored without backup")
        << "bakDir" << QByteArray() << false
        << QString()
        << QStringList{"f.conf=key = new\n", "f.conf.bak/", "f.conf.bak/keep=x"};
    QTest::newRow("copy back fails")
        << "" << QByteArray("case \"$3\" in *.tmp) echo 'cp: cannot write' >&2; exit 1 ;; esac\nexec /bin/cp \"$@\"")
        << true
        << QString("^Process: \"" + second + "\"\\. Exit code: 1\\.\n\"cp: cannot write\"$")
        << QStringList{"f.conf=key = old\n", "f.conf.bak=key = old\n", "f.conf.tmp=key = new\n"};
    QTest::newRow("work copy cannot be deleted")
        << "" << sabotage(":", "rm -f \"$3\"; mkdir \"$3\"; echo x > \"$3/keep\"") << false
        << QString("^\"%F/f\\.conf\\.tmp\" error \\d+\n[^\n]+$")
        << QStringList{"f.conf=key = new\n", "f.conf.tmp/", "f.conf.tmp/keep=x\n"};
}

void RegExpHandlerTest::failures()
{
    QFETCH(QString, setup);
    QFETCH(QByteArray, fakeCp);
    QFETCH(bool, backup);
    QFETCH(QString, messagePattern);
    QFETCH(QStringList, state);

    const QString file = path(QStringLiteral("f.conf"));
    if (setup == QLatin1String("dir")) {
        QVERIFY(QDir().mkpath(file));
    } else {
        QVERIFY(writeAll(file, "key = old\n"));
    }
    if (setup == QLatin1String("staleWorkDir"))
        QVERIFY(QDir().mkpath(file + QStringLiteral(".tmp")));
    if (setup == QLatin1String("bakDir")) {
        QVERIFY(QDir().mkpath(file + QStringLiteral(".bak")));
        QVERIFY(writeAll(file + QStringLiteral(".bak/keep"), "x"));
    }

    std::unique_ptr<FakePrograms> fakes;
    if (!fakeCp.isNull()) {
        fakes.reset(new FakePrograms);
        QVERIFY(fakes->isValid());
        if (fakeCp == "none")
            fakes->useOnlyFakes();
        else
            fakes->add(QStringLiteral("cp"), fakeCp);
    }

    KeyValueHandler handler;
    handler.replace.insert(QStringLiteral("key"), "new");
    QString error;
    const bool ok = RegExpHandler::rewriteSystemConfigureFile(file, handler, error, backup);
    fakes.reset();

    if (messagePattern.isEmpty()) {
        QVERIFY2(ok, qPrintable(error));
    } else {
        QVERIFY(!ok);
        // The folder placeholder may itself have been escaped with the rest.
        const QString folder = QRegularExpression::escape(_dir->path());
        const QRegularExpression re(
            messagePattern.replace(QLatin1String("\\%F"), folder).replace(QLatin1String("%F"), folder));
        QVERIFY2(re.match(error).hasMatch(), qPrintable(error));
    }

    QStringList actual;
    QDirIterator it(_dir->path(), QDir::AllEntries | QDir::NoDotAndDotDot | QDir::Hidden | QDir::System,
                    QDirIterator::Subdirectories);
    while (it.hasNext()) {
        it.next();
        const QFileInfo info = it.fileInfo();
        const QString name = QDir(_dir->path()).relativeFilePath(info.filePath());
        if (info.isSymLink())
            actual << name + QStringLiteral("=<symlink>");
        else if (info.isDir())
            actual << name + QLatin1Char('/');
        else
            actual << name + QLatin1Char('=') + QString::fromUtf8(readAll(info.filePath()));
    }
    actual.sort();
    state.sort();
    QCOMPARE(actual, state);
}

void RegExpHandlerTest::safeCopyMessages()
{
    const QString source = path(QStringLiteral("missing"));
    const QString destination = path(QStringLiteral("copy"));
    QString error = QStringLiteral("before");
    QVERIFY(!RegExpHandler::safeCopy(source, destination, error));
    // cp names itself as it was found on PATH.
    const QString expected = QStringLiteral("before\nProcess: \"cp --force --preserve=mode,ownership %1 %2\". "
                                            "Exit code: 1.\n\"(/\\S+/)?cp: cannot stat '%1': No such file or directory\"")
                                 .arg(QRegularExpression::escape(source), QRegularExpression::escape(destination));
    QVERIFY2(QRegularExpression(QLatin1Char('^') + expected + QLatin1Char('$')).match(error).hasMatch(),
             qPrintable(error));

    QVERIFY(writeAll(source, "data"));
    error.clear();
    QVERIFY(RegExpHandler::safeCopy(source, destination, error));
    QCOMPARE(error, QString());
    QCOMPARE(readAll(destination), QByteArray("data"));
}

QTEST_GUILESS_MAIN(RegExpHandlerTest)
#include "tst_regexphandler.moc"
