#include <kvt-common/regexphandler.h>

#include "systemtest.h"

#include <QRandomGenerator>
#include <QRegularExpression>
#include <QtTest>

#include <pwd.h>
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

} // namespace

class RegExpHandlerTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<QTemporaryDir> _dir;
    QString path(const QString &name) const { return _dir->filePath(name); }
    // Every entry under the folder as "name=content" (byte for byte), "name/" or "name=<symlink>".
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

    void failures_data()
    {
        // Each case optionally puts a fake cp first on PATH, rewrites "f.conf"
        // ("key = old\n", key replaced by "new") with a backup, and checks the
        // message against a pattern and the exact folder state. A case that
        // expects an empty folder starts without "f.conf".
        QTest::addColumn<QByteArray>("fakeCp"); // null: the real cp
        QTest::addColumn<QString>("messagePattern"); // FOLDER stands for the folder path
        QTest::addColumn<QStringList>("state");

        const QString cp = QStringLiteral("Process: \"cp --force --preserve=mode,ownership ");
        const QString first = "^" + QRegularExpression::escape(cp + "FOLDER/f.conf FOLDER/f.conf.tmp\"");
        const QString second = "^" + QRegularExpression::escape(cp + "FOLDER/f.conf.tmp FOLDER/f.conf\"");
        const QString old = QStringLiteral("f.conf=key = old\n");

        QTest::newRow("missing file") << QByteArray() << "^\"FOLDER/f\\.conf\" not exists$" << QStringList();
        QTest::newRow("cp fails, message trimmed")
            << QByteArray("printf '\\n  cp: disk on fire  \\n\\n' >&2\nexit 3")
            << first + "\\. Exit code: 3\\.\n\"cp: disk on fire\"$" << QStringList{old};
        QTest::newRow("work copy cannot be written completely")
            << QByteArray("/bin/cp \"$@\" && rm -f \"$4\" && ln -s /dev/full \"$4\"")
            << "^\"FOLDER/f\\.conf\\.tmp\" error \\d+\nNo space left on device$" << QStringList{old, "f.conf.tmp=<symlink>"};
        QTest::newRow("copy back fails")
            << QByteArray("case \"$3\" in *.tmp) echo 'cp: cannot write' >&2; exit 1 ;; esac\nexec /bin/cp \"$@\"")
            << second + "\\. Exit code: 1\\.\n\"cp: cannot write\"$"
            << QStringList{old, "f.conf.bak=key = old\n", "f.conf.tmp=key = new\n"};
    }

    void failures()
    {
        QFETCH(QByteArray, fakeCp);
        QFETCH(QString, messagePattern);
        QFETCH(QStringList, state);

        const QString file = path(QStringLiteral("f.conf"));
        if (!state.isEmpty())
            QVERIFY(writeFile(file, "key = old\n"));

        FakePrograms fakes;
        if (!fakeCp.isNull())
            fakes.add(QStringLiteral("cp"), fakeCp);
        KeyValueHandler handler(QStringLiteral("key=new"));
        QString error = QStringLiteral("earlier");
        QVERIFY(!RegExpHandler::rewriteSystemConfigureFile(file, handler, error, true));

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
