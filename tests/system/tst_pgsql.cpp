#include <kvt-common/appexception.h>
#include <kvt-common/pgsqlcluster.h>
#include <kvt-common/pgsqlmanager.h>
#include <kvt-common/pgsqlmanagerasync.h>
#include <kvt-common/process.h>

#include "fakeprograms.h"

#include <QDir>
#include <QPointer>
#include <QRegularExpression>
#include <QtTest>

#include <csignal>
#include <memory>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

namespace {

const char userQuery[] = "SELECT u.usename FROM pg_catalog.pg_user u;";

// Runs \a f and returns the text of the AppException it throws, or a null
// string.
template<typename F>
QString thrown(F f)
{
    try {
        f();
    } catch (const AppException &e) {
        return e.getText();
    }
    return QString();
}

std::unique_ptr<PgsqlCluster> cluster(const QString &line)
{
    return std::unique_ptr<PgsqlCluster>(PgsqlCluster::fromString(line));
}

// A fake su that logs its -c command line, one per line, and answers the user
// list query from the file "users" beside it; any other statement prints
// "DONE". Exit code and standard error come from "su-exit"/"su-stderr" when
// present.
const QByteArray fakeSu =
    "dir=$(dirname \"$0\")\n"
    "[ \"$1\" = postgres ] && [ \"$2\" = -c ] || { echo \"bad arguments: $*\" >&2; exit 99; }\n"
    "printf '%s\\n' \"$3\" >> \"$dir/su-log\"\n"
    "[ -f \"$dir/su-stderr\" ] && cat \"$dir/su-stderr\" >&2\n"
    "[ -f \"$dir/su-exit\" ] && exit $(cat \"$dir/su-exit\")\n"
    "case \"$3\" in *usename*) cat \"$dir/users\" ;; *) echo DONE ;; esac\n";

void writeFile(const QString &path, const QByteArray &content)
{
    QFile f(path);
    if (f.open(QIODevice::WriteOnly | QIODevice::Truncate))
        f.write(content);
}

QByteArray psqlUsers(const QStringList &names)
{
    QByteArray out = " usename  \n----------\n";
    for (const QString &n : names)
        out += ' ' + n.toUtf8() + '\n';
    out += '(' + QByteArray::number(names.size()) + (names.size() == 1 ? " row)\n\n" : " rows)\n\n");
    return out;
}

// Records the signals of a PgsqlManagerAsync as readable strings.
class AsyncLog : public QObject
{
    Q_OBJECT
public:
    explicit AsyncLog(PgsqlManagerAsync *manager)
    {
        connect(manager, SIGNAL(clustersReaded(const QList<PgsqlCluster *> &)), this,
                SLOT(onClusters(const QList<PgsqlCluster *> &)));
        connect(manager, SIGNAL(exceptionArise(const AppException &)), this, SLOT(onException(const AppException &)));
    }
    QStringList entries;
    QList<QPointer<PgsqlCluster>> lastClusters;
    int readsDone = 0;

public Q_SLOTS:
    void onClusters(const QList<PgsqlCluster *> &clusters)
    {
        QStringList names;
        lastClusters.clear();
        for (PgsqlCluster *c : clusters) {
            names << c->version() + QLatin1Char('/') + c->name();
            lastClusters << c;
        }
        entries << QStringLiteral("clustersReaded(%1)").arg(names.join(QLatin1Char(',')));
        ++readsDone;
    }
    void onException(const AppException &e)
    {
        entries << QStringLiteral("exceptionArise(%1)").arg(e.getText());
    }
};

// A throw-away cluster of our own on a free port, dropped again whatever
// happens to the tests in between.
class ScratchCluster
{
public:
    QString skipReason;
    QString version;
    QString name;
    int port = 0;

    bool create()
    {
        if (geteuid() != 0)
            return fail(QStringLiteral("creating a PostgreSQL cluster needs root"));
        for (const char *tool : {"pg_createcluster", "pg_dropcluster", "pg_lsclusters", "pg_ctlcluster", "psql", "su"}) {
            if (QStandardPaths::findExecutable(QLatin1String(tool)).isEmpty())
                return fail(QStringLiteral("%1 is not installed").arg(QLatin1String(tool)));
        }
        QStringList versions = QDir(QStringLiteral("/usr/lib/postgresql")).entryList(QDir::Dirs | QDir::NoDotAndDotDot);
        std::sort(versions.begin(), versions.end(), [](const QString &a, const QString &b) { return a.toInt() < b.toInt(); });
        if (versions.isEmpty())
            return fail(QStringLiteral("no PostgreSQL server is installed"));
        version = versions.last();
        dropStale();
        name = QStringLiteral("kvttest_%1").arg(getpid());
        port = freePort();
        if (port == 0)
            return fail(QStringLiteral("no free TCP port for a test cluster"));
        QString output;
        if (!run(QStringLiteral("pg_createcluster"), {version, name, QStringLiteral("-p"), QString::number(port)}, &output)) {
            name.clear();
            return fail(QStringLiteral("pg_createcluster failed: ") + output);
        }
        return true;
    }

    void drop()
    {
        if (name.isEmpty())
            return;
        run(QStringLiteral("pg_dropcluster"), {QStringLiteral("--stop"), version, name});
        name.clear();
    }

    ~ScratchCluster() { drop(); }

private:
    bool fail(const QString &reason)
    {
        skipReason = reason;
        return false;
    }

    static bool run(const QString &program, const QStringList &arguments, QString *output = nullptr)
    {
        QProcess p;
        p.setProcessChannelMode(QProcess::MergedChannels);
        p.start(program, arguments);
        const bool ok = p.waitForFinished(60000) && p.exitStatus() == QProcess::NormalExit && p.exitCode() == 0;
        if (output)
            *output = QString::fromLocal8Bit(p.readAll());
        return ok;
    }

    // Clusters left behind by runs that crashed before their clean-up.
    void dropStale()
    {
        QProcess p;
        p.start(QStringLiteral("pg_lsclusters"), {QStringLiteral("--no-header")});
        p.waitForFinished(30000);
        const QStringList lines = QString::fromLocal8Bit(p.readAllStandardOutput()).split(QLatin1Char('\n'));
        const QRegularExpression stale(QStringLiteral("^(\\S+)\\s+kvttest_(\\d+)\\s"));
        for (const QString &line : lines) {
            const QRegularExpressionMatch m = stale.match(line);
            if (m.hasMatch() && ::kill(pid_t(m.captured(2).toInt()), 0) != 0)
                run(QStringLiteral("pg_dropcluster"), {QStringLiteral("--stop"), m.captured(1),
                                                       QStringLiteral("kvttest_") + m.captured(2)});
        }
    }

    static int freePort()
    {
        for (int candidate = 55432 + getpid() % 500; candidate < 65000; candidate += 7) {
            const int s = ::socket(AF_INET, SOCK_STREAM, 0);
            sockaddr_in address{};
            address.sin_family = AF_INET;
            address.sin_port = htons(quint16(candidate));
            address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
            const bool free = ::bind(s, reinterpret_cast<sockaddr *>(&address), sizeof address) == 0;
            ::close(s);
            if (free)
                return candidate;
        }
        return 0;
    }
};

} // namespace

class PgsqlTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void cleanupTestCase();

    void clusterLine_data();
    void clusterLine();
    void userList_data();
    void userList();
    void commandLines();
    void createAndDeleteUsers_data();
    void createAndDeleteUsers();
    void unsafeInputRefused_data();
    void unsafeInputRefused();
    void clusterControl();
    void readClusters_data();
    void readClusters();
    void readReplacesAndDeletesClusters();
    void asynchronousRead_data();
    void asynchronousRead();
    void asynchronousReadDestroyedWhileRunning();
    void serverPackage();

    void realClusterLifecycle();

private:
    ScratchCluster _scratch;
    bool _scratchCreated = false;
};

void PgsqlTest::initTestCase()
{
    _scratchCreated = _scratch.create();
}

void PgsqlTest::cleanupTestCase()
{
    _scratch.drop();
}

void PgsqlTest::clusterLine_data()
{
    QTest::addColumn<QString>("line");
    QTest::addColumn<QStringList>("fields"); // empty: refused

    QTest::newRow("seven fields, runs of blanks")
        << "11  main    5432 online postgres /var/lib/postgresql/11/main   /var/log/postgresql/postgresql-11-main.log"
        << QStringList{"11", "main", "5432", "online", "postgres", "/var/lib/postgresql/11/main",
                       "/var/log/postgresql/postgresql-11-main.log"};
    QTest::newRow("tabs and surrounding blanks")
        << "  15\tdev\t5433\tdown\tpostgres\t/srv/pg/dev\t/var/log/dev.log \r"
        << QStringList{"15", "dev", "5433", "down", "postgres", "/srv/pg/dev", "/var/log/dev.log"};
    QTest::newRow("status with a comma")
        << "15 standby 5434 online,recovery postgres /d /l"
        << QStringList{"15", "standby", "5434", "online,recovery", "postgres", "/d", "/l"};
    QTest::newRow("surplus field goes to the earliest group")
        << "11 main extra 5432 online postgres /d /l"
        << QStringList{"11 main", "extra", "5432", "online", "postgres", "/d", "/l"};
    QTest::newRow("port too large for an int")
        << "11 main 99999999999 online postgres /d /l"
        << QStringList{"11", "main", "0", "online", "postgres", "/d", "/l"};
    QTest::newRow("non-numeric port") << "11 main 54x2 online postgres /d /l" << QStringList();
    QTest::newRow("six fields") << "11 main 5432 online postgres /d" << QStringList();
    QTest::newRow("header line") << "Ver Cluster Port Status Owner    Data directory   Log file" << QStringList();
    QTest::newRow("blank") << "   " << QStringList();
}

void PgsqlTest::clusterLine()
{
    QFETCH(QString, line);
    QFETCH(QStringList, fields);

    std::unique_ptr<PgsqlCluster> parsed;
    const QString message = thrown([&] { parsed = cluster(line); });
    if (fields.isEmpty()) {
        QCOMPARE(message, QStringLiteral("Cluster info not valid '%1'").arg(line));
        QVERIFY(!parsed);
        return;
    }
    QVERIFY2(message.isNull(), qPrintable(message));
    QVERIFY(!parsed->parent());
    QCOMPARE((QStringList{parsed->version(), parsed->name(), QString::number(parsed->port()), parsed->status(),
                          parsed->owner(), parsed->dataDirectory(), parsed->logFile()}),
             fields);
}

void PgsqlTest::userList_data()
{
    QTest::addColumn<QByteArray>("output");
    QTest::addColumn<QStringList>("users"); // null entry list with "!": not matched

    QTest::newRow("two users") << psqlUsers({"postgres", "alice"}) << QStringList{"postgres", "alice"};
    QTest::newRow("one row") << psqlUsers({"postgres"}) << QStringList{"postgres"};
    QTest::newRow("zero rows") << psqlUsers({}) << QStringList();
    QTest::newRow("count not checked") << QByteArray(" usename\n---\n a\n b\n c\n(1 row)\n") << QStringList{"a", "b", "c"};
    QTest::newRow("blank lines between names")
        << QByteArray("usename\n-------\n  a  \n\n b\n(2 rows)") << QStringList{"a", "b"};
    QTest::newRow("no header") << QByteArray("postgres\n(1 row)\n") << QStringList{"!"};
    QTest::newRow("no footer") << QByteArray(" usename\n---------\n postgres\n") << QStringList{"!"};
    QTest::newRow("empty output") << QByteArray() << QStringList{"!"};
}

void PgsqlTest::userList()
{
    QFETCH(QByteArray, output);
    QFETCH(QStringList, users);

    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    fakes.add(QStringLiteral("su"), fakeSu);
    writeFile(fakes.filePath(QStringLiteral("users")), output);

    const auto c = cluster(QStringLiteral("15 main 5433 online postgres /d /l"));
    QStringList names;
    const QString message = thrown([&] { names = c->usernames(); });
    if (users == QStringList{"!"}) {
        QCOMPARE(message, QStringLiteral("SQL request '%1' not mathed").arg(QLatin1String(userQuery)));
    } else {
        QVERIFY2(message.isNull(), qPrintable(message));
        QCOMPARE(names, users);
    }
}

void PgsqlTest::commandLines()
{
    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    fakes.add(QStringLiteral("su"), fakeSu);
    const auto c = cluster(QStringLiteral("15 main 5433 online postgres /d /l"));

    // Benign statements reach su exactly as written, inside the quotes.
    QCOMPARE(c->sqlRequest(QStringLiteral("SELECT 'a b', 1 % 2 FROM t WHERE x <> 'it''s';")), QStringLiteral("DONE\n"));
    QCOMPARE(fakes.read(QStringLiteral("su-log")),
             QByteArray("psql -p 5433 -c \"SELECT 'a b', 1 % 2 FROM t WHERE x <> 'it''s';\"\n"));

    // A failing psql surfaces as the exit-code message with its error text.
    writeFile(fakes.filePath(QStringLiteral("su-exit")), "2");
    writeFile(fakes.filePath(QStringLiteral("su-stderr")), "psql: error: connection refused\n");
    QCOMPARE(thrown([&] { c->sqlRequest(QStringLiteral("SELECT 1;")); }),
             QStringLiteral("Process 'su postgres -c psql -p 5433 -c \"SELECT 1;\"' execute with error code '2'. "
                            "psql: error: connection refused\n"));

    // No su at all.
    fakes.useOnlyFakes();
    QFile::remove(fakes.filePath(QStringLiteral("su")));
    QCOMPARE(thrown([&] { c->usernames(); }),
             QStringLiteral("Process 'su postgres -c psql -p 5433 -c \"%1\"' not finished").arg(QLatin1String(userQuery)));
}

void PgsqlTest::createAndDeleteUsers_data()
{
    QTest::addColumn<QString>("operation");
    QTest::addColumn<QString>("name");
    QTest::addColumn<QStringList>("statements"); // after the user list query

    QTest::newRow("create existing") << "create" << "alice" << QStringList();
    QTest::newRow("create new") << "create" << "bob" << QStringList{"create user bob;"};
    QTest::newRow("delete existing") << "delete" << "alice" << QStringList{"drop user alice;"};
    QTest::newRow("delete unknown") << "delete" << "bob" << QStringList();
    QTest::newRow("delete is case-sensitive") << "delete" << "alice_" << QStringList();
}

void PgsqlTest::createAndDeleteUsers()
{
    QFETCH(QString, operation);
    QFETCH(QString, name);
    QFETCH(QStringList, statements);

    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    fakes.add(QStringLiteral("su"), fakeSu);
    writeFile(fakes.filePath(QStringLiteral("users")), psqlUsers({"postgres", "alice"}));
    const auto c = cluster(QStringLiteral("15 main 5433 online postgres /d /l"));

    const QString message = thrown([&] {
        if (operation == QLatin1String("create"))
            c->createUser(name);
        else
            c->deleteUser(name);
    });
    QVERIFY2(message.isNull(), qPrintable(message));

    QStringList expected{QStringLiteral("psql -p 5433 -c \"%1\"").arg(QLatin1String(userQuery))};
    for (const QString &s : statements)
        expected << QStringLiteral("psql -p 5433 -c \"%1\"").arg(s);
    QCOMPARE(QString::fromUtf8(fakes.read(QStringLiteral("su-log"))).split(QLatin1Char('\n'), Qt::SkipEmptyParts),
             expected);
}

void PgsqlTest::unsafeInputRefused_data()
{
    QTest::addColumn<QString>("operation");
    QTest::addColumn<QString>("text");
    QTest::addColumn<QString>("message");

    const QString request = QStringLiteral("SQL request '%1' contains a character that cannot be passed to the shell");
    const QString user = QStringLiteral("User name '%1' is not a plain SQL identifier");
    const QStringList queries{QStringLiteral("SELECT \"x\";"), QStringLiteral("SELECT 1;\\! id"),
                              QStringLiteral("SELECT '$HOME';"), QStringLiteral("SELECT '`id`';"),
                              QStringLiteral("SELECT 1;\nDROP ROLE x;"), QStringLiteral("SELECT 1;\r")};
    for (const QString &q : queries)
        QTest::newRow(qPrintable(QStringLiteral("query ") + QString(q).replace(QLatin1Char('\n'), QLatin1String("\\n"))))
            << "sql" << q << request.arg(q);
    const QStringList names{QStringLiteral("bob; drop user postgres"), QStringLiteral("bob\"; id; \""),
                            QStringLiteral("1bob"), QStringLiteral("Bob"), QStringLiteral("bob smith"),
                            QString(), QStringLiteral("b$x"), QString(64, QLatin1Char('a'))};
    for (const QString &n : names) {
        QTest::newRow(qPrintable(QStringLiteral("create '%1'").arg(n.left(20)))) << "create" << n << user.arg(n);
        QTest::newRow(qPrintable(QStringLiteral("delete '%1'").arg(n.left(20)))) << "delete" << n << user.arg(n);
    }
}

void PgsqlTest::unsafeInputRefused()
{
    QFETCH(QString, operation);
    QFETCH(QString, text);
    QFETCH(QString, message);

    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    fakes.add(QStringLiteral("su"), fakeSu);
    writeFile(fakes.filePath(QStringLiteral("users")), psqlUsers({"postgres"}));
    const auto c = cluster(QStringLiteral("15 main 5433 online postgres /d /l"));

    QCOMPARE(thrown([&] {
                 if (operation == QLatin1String("sql"))
                     c->sqlRequest(text);
                 else if (operation == QLatin1String("create"))
                     c->createUser(text);
                 else
                     c->deleteUser(text);
             }),
             message);
    // Refused before anything ran.
    QCOMPARE(fakes.read(QStringLiteral("su-log")), QByteArray());
}

void PgsqlTest::clusterControl()
{
    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    // Running clusters are those named in the file "running"; "start" of the
    // cluster "broken" fails.
    fakes.add(QStringLiteral("pg_ctlcluster"),
              "dir=$(dirname \"$0\")\necho \"$*\" >> \"$dir/log\"\n"
              "case \"$3\" in\n"
              "status) grep -qx \"$1/$2\" \"$dir/running\" && exit 0; exit 3 ;;\n"
              "start) [ \"$2\" = broken ] && { echo 'Error: could not start' >&2; exit 1; }\n"
              "       echo \"$1/$2\" >> \"$dir/running\" ;;\n"
              "esac\n");
    writeFile(fakes.filePath(QStringLiteral("running")), "15/main\n");
    const auto main = cluster(QStringLiteral("15 main 5432 online postgres /d /l"));
    const auto dev = cluster(QStringLiteral("15 dev 5433 down postgres /d /l"));
    const auto broken = cluster(QStringLiteral("13 broken 5434 down postgres /d /l"));

    QVERIFY(main->isWork());
    QVERIFY(!dev->isWork());
    QVERIFY(PgsqlManager::allClustersWork({}));
    QVERIFY(PgsqlManager::allClustersWork({main.get()}));
    QFile::remove(fakes.filePath(QStringLiteral("log")));
    // The walk stops at the first cluster that does not run.
    QVERIFY(!PgsqlManager::allClustersWork({dev.get(), main.get()}));
    QCOMPARE(fakes.read(QStringLiteral("log")), QByteArray("15 dev status\n"));

    dev->start();
    QVERIFY(dev->isWork());
    QVERIFY(PgsqlManager::allClustersWork({main.get(), dev.get()}));
    QCOMPARE(thrown([&] { broken->start(); }),
             QStringLiteral("Process 'pg_ctlcluster 13 broken start' execute with error code '1'. Error: could not start\n"));

    // A status that crashes is an error, not "not running".
    fakes.add(QStringLiteral("pg_ctlcluster"), "kill -TERM $$");
    QCOMPARE(thrown([&] { main->isWork(); }), QStringLiteral("Process 'pg_ctlcluster 15 main status' not finished"));
}

void PgsqlTest::readClusters_data()
{
    QTest::addColumn<QByteArray>("script");
    QTest::addColumn<QStringList>("clusters");
    QTest::addColumn<QString>("message");

    const QByteArray list = "[ \"$*\" = --no-header ] || exit 9\n";
    QTest::newRow("zero rows") << QByteArray(list + "exit 0") << QStringList() << QString();
    QTest::newRow("two clusters, blank lines skipped")
        << QByteArray(list + "printf '\\n11 main 5432 online postgres /a /b\\n\\n15 dev 5433 down postgres /c /d\\n'")
        << QStringList{"11/main:5432", "15/dev:5433"} << QString();
    QTest::newRow("malformed second line keeps the first")
        << QByteArray(list + "printf '11 main 5432 online postgres /a /b\\nbroken line\\n15 dev 5433 down postgres /c /d\\n'")
        << QStringList{"11/main:5432"} << QStringLiteral("Cluster info not valid 'broken line'");
    QTest::newRow("tool fails")
        << QByteArray(list + "echo 'Error: no permission' >&2; exit 1") << QStringList()
        << QStringLiteral("Process 'pg_lsclusters --no-header' execute with error code '1'. Error: no permission\n");
    QTest::newRow("tool missing") << QByteArray() << QStringList()
                                  << QStringLiteral("Process 'pg_lsclusters --no-header' not finished");
}

void PgsqlTest::readClusters()
{
    QFETCH(QByteArray, script);
    QFETCH(QStringList, clusters);
    QFETCH(QString, message);

    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    if (script.isNull())
        fakes.useOnlyFakes();
    else
        fakes.add(QStringLiteral("pg_lsclusters"), script);

    PgsqlManager manager;
    QCOMPARE(thrown([&] { manager.readClusters(); }), message);
    QStringList actual;
    for (const PgsqlCluster *c : manager.getClusters())
        actual << QStringLiteral("%1/%2:%3").arg(c->version(), c->name()).arg(c->port());
    QCOMPARE(actual, clusters);
}

void PgsqlTest::readReplacesAndDeletesClusters()
{
    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    fakes.add(QStringLiteral("pg_lsclusters"), "printf '11 main 5432 online postgres /a /b\\n12 x 5 down p /c /d\\n'");

    QList<QPointer<PgsqlCluster>> first;
    QList<QPointer<PgsqlCluster>> second;
    {
        PgsqlManager manager;
        manager.readClusters();
        for (PgsqlCluster *c : manager.getClusters())
            first << c;
        QCOMPARE(first.size(), 2);

        // A failing read has already dropped the previous clusters.
        fakes.add(QStringLiteral("pg_lsclusters"), "exit 1");
        QVERIFY(!thrown([&] { manager.readClusters(); }).isNull());
        for (const QPointer<PgsqlCluster> &c : qAsConst(first))
            QVERIFY(c.isNull());
        QVERIFY(manager.getClusters().isEmpty());

        fakes.add(QStringLiteral("pg_lsclusters"), "echo '11 main 5432 online postgres /a /b'");
        manager.readClusters();
        for (PgsqlCluster *c : manager.getClusters())
            second << c;
        QCOMPARE(second.size(), 1);
    }
    // The manager's destructor deletes its last clusters.
    QVERIFY(second.first().isNull());
}

void PgsqlTest::asynchronousRead_data()
{
    QTest::addColumn<QByteArray>("script");
    QTest::addColumn<QStringList>("signalsExpected");

    QTest::newRow("two clusters")
        << QByteArray("printf '11 main 5432 online postgres /a /b\\n15 dev 5433 down postgres /c /d\\n'")
        << QStringList{"clustersReaded(11/main,15/dev)"};
    QTest::newRow("zero rows") << QByteArray("exit 0") << QStringList{"clustersReaded()"};
    QTest::newRow("failure after one line")
        << QByteArray("printf '11 main 5432 online postgres /a /b\\nnot a cluster\\n'")
        << QStringList{"exceptionArise(Cluster info not valid 'not a cluster')", "clustersReaded(11/main)"};
    QTest::newRow("tool missing")
        << QByteArray() << QStringList{"exceptionArise(Process 'pg_lsclusters --no-header' not finished)", "clustersReaded()"};
}

void PgsqlTest::asynchronousRead()
{
    QFETCH(QByteArray, script);
    QFETCH(QStringList, signalsExpected);

    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    if (script.isNull())
        fakes.useOnlyFakes();
    else
        fakes.add(QStringLiteral("pg_lsclusters"), script);

    PgsqlManagerAsync manager;
    AsyncLog log(&manager);
    manager.startReadClusters();
    QTRY_COMPARE_WITH_TIMEOUT(log.readsDone, 1, 35000);
    QCOMPARE(log.entries, signalsExpected);

    // A second read replaces, and deletes, the clusters of the first.
    const QList<QPointer<PgsqlCluster>> before = log.lastClusters;
    manager.startReadClusters();
    QTRY_COMPARE_WITH_TIMEOUT(log.readsDone, 2, 35000);
    for (const QPointer<PgsqlCluster> &c : before)
        QVERIFY(c.isNull());
}

void PgsqlTest::asynchronousReadDestroyedWhileRunning()
{
    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    fakes.add(QStringLiteral("pg_lsclusters"), "sleep 1\necho '11 main 5432 online postgres /a /b'");

    auto *manager = new PgsqlManagerAsync;
    AsyncLog log(manager);
    manager->startReadClusters();
    // A second request while the first runs is not a second reader of the
    // same list.
    manager->startReadClusters();
    QTRY_COMPARE_WITH_TIMEOUT(log.readsDone, 1, 35000);
    QCOMPARE(log.entries, QStringList{"clustersReaded(11/main)"});
    QTest::qWait(100);
    QCOMPARE(log.readsDone, 1);

    manager->startReadClusters();
    delete manager; // waits for the running read instead of leaving it a dead manager
    QCoreApplication::processEvents();
    QCOMPARE(log.readsDone, 1);
}

void PgsqlTest::serverPackage()
{
    FakePrograms fakes;
    QVERIFY(fakes.isValid());
    fakes.add(QStringLiteral("dpkg-query"),
              "echo \"$3\" > \"$(dirname \"$0\")/asked\"\n"
              "case \"$3\" in 'postgresql-[0123456789]*') echo 'deinstall ok config-files'; echo 'install ok installed' ;; esac");
    QVERIFY(PgsqlManager().packagesInslled());
    QCOMPARE(fakes.read(QStringLiteral("asked")), QByteArray("postgresql-[0123456789]*\n"));

    fakes.add(QStringLiteral("dpkg-query"), "echo 'deinstall ok config-files'");
    QVERIFY(!PgsqlManager().packagesInslled());
}

void PgsqlTest::realClusterLifecycle()
{
    if (!_scratchCreated)
        QSKIP(qPrintable(QStringLiteral("no scratch PostgreSQL cluster: ") + _scratch.skipReason));

    PgsqlManager manager;
    manager.readClusters();
    PgsqlCluster *ours = nullptr;
    for (PgsqlCluster *c : manager.getClusters()) {
        if (c->name() == _scratch.name)
            ours = c;
    }
    QVERIFY2(ours, "the new cluster is not listed");
    QCOMPARE(ours->version(), _scratch.version);
    QCOMPARE(ours->port(), _scratch.port);
    QCOMPARE(ours->owner(), QStringLiteral("postgres"));
    QVERIFY(ours->logFile().endsWith(QLatin1String(".log")));

    QVERIFY(!ours->isWork());
    QVERIFY(!PgsqlManager::allClustersWork({ours}));
    ours->start();
    QVERIFY(ours->isWork());

    QVERIFY(ours->usernames().contains(QStringLiteral("postgres")));
    const QString user = QStringLiteral("kvt_user_%1").arg(getpid());
    QVERIFY(!ours->usernames().contains(user));
    ours->createUser(user);
    QVERIFY(ours->usernames().contains(user));
    ours->createUser(user); // present already: nothing to do, no error
    QCOMPARE(ours->usernames().count(user), 1);
    ours->deleteUser(user);
    QVERIFY(!ours->usernames().contains(user));
    ours->deleteUser(user);

    // A statement the server rejects comes back with psql's message.
    const QString message = thrown([&] { ours->sqlRequest(QStringLiteral("create user select;")); });
    QVERIFY2(message.contains(QLatin1String("execute with error code")) && message.contains(QLatin1String("ERROR")),
             qPrintable(message));

    // The same list, read in the background.
    PgsqlManagerAsync async;
    AsyncLog log(&async);
    async.startReadClusters();
    QTRY_COMPARE_WITH_TIMEOUT(log.readsDone, 1, 35000);
    QVERIFY2(log.entries.first().contains(_scratch.version + QLatin1Char('/') + _scratch.name),
             qPrintable(log.entries.join(QLatin1Char(' '))));
}

QTEST_GUILESS_MAIN(PgsqlTest)
#include "tst_pgsql.moc"
