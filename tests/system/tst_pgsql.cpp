// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/pgsqlcluster.h>
#include <kvt-common/pgsqlmanager.h>
#include <kvt-common/pgsqlmanagerasync.h>

#include "systemtest.h"

#include <QDeadlineTimer>
#include <QPointer>
#include <QScopeGuard>
#include <QThreadPool>
#include <QtTest>

#include <memory>
#include <unistd.h>

namespace {

const QString userQuery = QStringLiteral("SELECT u.usename FROM pg_catalog.pg_user u;");
const QString twoClusters = QStringLiteral("printf '11 main 5432 online postgres /a /b\\n\\n15 dev 5433 down postgres /c /d\\n'");

std::unique_ptr<PgsqlCluster> cluster(const QString &line = QStringLiteral("15 main 5433 online postgres /d /l"))
{
    return std::unique_ptr<PgsqlCluster>(PgsqlCluster::fromString(line));
}

// A fake su that logs its -c command, one per line, to "su-log", answers the
// user list query with the file "users" (users postgres and alice), fails for
// a statement naming "fail" and answers any other with "DONE".
void addFakeSu(FakePrograms &fakes)
{
    fakes.add(QStringLiteral("su"),
              "dir=$(dirname \"$0\")\n"
              "[ \"$1\" = postgres ] && [ \"$2\" = -c ] || { echo \"bad arguments: $*\" >&2; exit 99; }\n"
              "printf '%s\\n' \"$3\" >> \"$dir/su-log\"\n"
              "case \"$3\" in *usename*) cat \"$dir/users\" ;; *fail*) echo 'psql: error: connection refused' >&2; exit 2 ;;\n"
              "*) echo DONE ;; esac\n");
    writeFile(fakes.filePath(QStringLiteral("users")), " usename\n----------\n  postgres  \n\n alice\n(2 rows)\n\n");
}

QString describe(const QList<PgsqlCluster *> &clusters)
{
    QStringList names;
    for (const PgsqlCluster *c : clusters)
        names << QStringLiteral("%1/%2:%3").arg(c->version(), c->name()).arg(c->port());
    return names.join(QLatin1Char(','));
}

// Records the signals of a PgsqlManagerAsync in *entries as readable strings.
void watch(PgsqlManagerAsync *manager, QStringList *entries)
{
    QObject::connect(manager, &PgsqlManagerAsync::clustersReaded,
                     [entries](const QList<PgsqlCluster *> &c) { *entries << "clustersReaded(" + describe(c) + ')'; });
    QObject::connect(manager, &PgsqlManagerAsync::exceptionArise,
                     [entries](const AppException &e) { *entries << "exceptionArise(" + e.getText() + ')'; });
}

} // namespace

class PgsqlTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void clusterLine_data()
    {
        QTest::addColumn<QString>("line");
        QTest::addColumn<QString>("result"); // the fields joined by '|', or the exception's text

        QTest::newRow("runs of blanks and tabs")
            << "  11  main \t 5432 online,recovery postgres /var/lib/postgresql/11/main   /var/log/pg.log \r"
            << "11|main|5432|online,recovery|postgres|/var/lib/postgresql/11/main|/var/log/pg.log";
        QTest::newRow("surplus field goes to the earliest group")
            << "11 main extra 5432 online postgres /d /l" << "11 main|extra|5432|online|postgres|/d|/l";
        QTest::newRow("six fields") << "11 main 5432 online postgres /d" << "Cluster info not valid '11 main 5432 online postgres /d'";
    }

    void clusterLine()
    {
        QFETCH(QString, line);
        QFETCH(QString, result);

        std::unique_ptr<PgsqlCluster> c;
        const QString message = thrown([&] { c = cluster(line); });
        const QStringList fields = c ? QStringList{c->version(), c->name(), QString::number(c->port()), c->status(),
                                                   c->owner(), c->dataDirectory(), c->logFile()}
                                     : QStringList();
        QCOMPARE(c ? fields.join(QLatin1Char('|')) : message, result);
    }

    void userStatements_data()
    {
        QTest::addColumn<QString>("operation");
        QTest::addColumn<QString>("text"); // for "users": the output of psql
        QTest::addColumn<QStringList>("statements"); // what reaches psql
        QTest::addColumn<QString>("message"); // for "users": the names joined by ',' unless it fails

        const QString users = userQuery;
        QTest::newRow("user list, count not checked") << "users" << " usename\n---\n a\n b\n c\n(1 row)\n" << QStringList{users}
                                                      << "a,b,c";
        QTest::newRow("user list without footer") << "users" << " usename\n---------\n postgres\n" << QStringList{users}
                                                  << QStringLiteral("SQL request '%1' not mathed").arg(userQuery);
        QTest::newRow("create existing") << "create" << "alice" << QStringList{users} << QString();
        QTest::newRow("create new") << "create" << "bob" << QStringList{users, "create user bob;"} << QString();
        QTest::newRow("delete existing") << "delete" << "alice" << QStringList{users, "drop user alice;"} << QString();
        const QString benign = QStringLiteral("SELECT 'a b', 1 % 2 FROM t WHERE x <> 'it''s';");
        QTest::newRow("benign query reaches psql as written") << "sql" << benign << QStringList{benign} << QString();
        QTest::newRow("psql fails") << "sql" << "SELECT fail;" << QStringList{"SELECT fail;"}
                                    << "Process 'su postgres -c psql -p 5433 -c \"SELECT fail;\"' execute with error code '2'. "
                                       "psql: error: connection refused\n";

        // Anything that could leave the shell quotes, or a name the server would fold, runs nothing.
        for (const char *query : {"SELECT \"x\";", "SELECT 1;\\! id", "SELECT '$HOME';", "SELECT 1;\nDROP ROLE x;"})
            QTest::newRow(qPrintable(QStringLiteral("refused query ") + QString::fromLatin1(query).replace('\n', "\\n")))
                << "sql" << query << QStringList()
                << QStringLiteral("SQL request '%1' contains a character that cannot be passed to the shell").arg(query);
        for (const QString &name : {QStringLiteral("bob; drop user postgres"), QStringLiteral("1bob"), QStringLiteral("Bob"),
                                    QStringLiteral("alice\n"), QString(64, QLatin1Char('a'))})
            QTest::newRow(qPrintable(QStringLiteral("refused user '%1'").arg(name.left(20).replace('\n', "\\n"))))
                << (name.size() > 20 ? "delete" : "create") << name << QStringList()
                << QStringLiteral("User name '%1' is not a plain SQL identifier").arg(name);
    }

    void userStatements()
    {
        QFETCH(QString, operation);
        QFETCH(QString, text);
        QFETCH(QStringList, statements);
        QFETCH(QString, message);

        FakePrograms fakes;
        addFakeSu(fakes);
        if (operation == QLatin1String("users"))
            writeFile(fakes.filePath(QStringLiteral("users")), text.toUtf8());
        const auto c = cluster();
        QString names;
        const QMap<QString, std::function<void()>> run{{"sql", [&] { c->sqlRequest(text); }},
                                                       {"create", [&] { c->createUser(text); }},
                                                       {"delete", [&] { c->deleteUser(text); }},
                                                       {"users", [&] { names = c->usernames().join(','); }}};
        QCOMPARE(thrown(run[operation]) + names, message);
        QStringList expected;
        for (const QString &statement : statements)
            expected << QStringLiteral("psql -p 5433 -c \"%1\"").arg(statement);
        QCOMPARE(QString::fromUtf8(fakes.read(QStringLiteral("su-log"))).split('\n', Qt::SkipEmptyParts), expected);
    }

    void clusterControl()
    {
        FakePrograms fakes;
        // Running clusters are those named in the file "running".
        fakes.add(QStringLiteral("pg_ctlcluster"), "dir=$(dirname \"$0\")\ncase \"$3\" in\n"
                  "status) grep -qx \"$1/$2\" \"$dir/running\" && exit 0; exit 3 ;;\n"
                  "start) echo \"$1/$2\" >> \"$dir/running\" ;;\nesac\n");
        writeFile(fakes.filePath(QStringLiteral("running")), "15/main\n");
        const auto main = cluster(QStringLiteral("15 main 5432 online postgres /d /l"));
        const auto dev = cluster(QStringLiteral("15 dev 5433 down postgres /d /l"));

        QVERIFY(!PgsqlManager::allClustersWork({main.get(), dev.get()}));
        dev->start();
        QVERIFY(PgsqlManager::allClustersWork({main.get(), dev.get()}));
        // A status that crashes is an error, not "not running".
        fakes.add(QStringLiteral("pg_ctlcluster"), "kill -TERM $$");
        QCOMPARE(thrown([&] { main->isWork(); }), QStringLiteral("Process 'pg_ctlcluster 15 main status' not finished"));
    }

    void readClusters_data()
    {
        QTest::addColumn<QString>("script");
        QTest::addColumn<QString>("clusters");
        QTest::addColumn<QString>("message");

        QTest::newRow("two clusters, blank line skipped") << twoClusters << "11/main:5432,15/dev:5433" << QString();
        QTest::newRow("malformed second line keeps the first")
            << "printf '11 main 5432 online postgres /a /b\\nbroken line\\n15 dev 5433 down postgres /c /d\\n'"
            << "11/main:5432" << "Cluster info not valid 'broken line'";
        QTest::newRow("tool fails") << "echo 'Error: no permission' >&2; exit 1" << ""
                                    << "Process 'pg_lsclusters --no-header' execute with error code '1'. Error: no permission\n";
    }

    void readClusters()
    {
        QFETCH(QString, script);
        QFETCH(QString, clusters);
        QFETCH(QString, message);

        FakePrograms fakes;
        fakes.add(QStringLiteral("pg_lsclusters"), "[ \"$*\" = --no-header ] || exit 9\n" + twoClusters.toUtf8());
        PgsqlManager manager;
        manager.readClusters();
        const QList<QPointer<PgsqlCluster>> first(manager.getClusters().cbegin(), manager.getClusters().cend());
        QCOMPARE(first.size(), 2);

        fakes.add(QStringLiteral("pg_lsclusters"), "[ \"$*\" = --no-header ] || exit 9\n" + script.toUtf8());
        QCOMPARE(thrown([&] { manager.readClusters(); }), message);
        QCOMPARE(describe(manager.getClusters()), clusters);
        // Every read, failing ones included, deletes the clusters of the one before.
        for (const QPointer<PgsqlCluster> &c : first)
            QVERIFY(c.isNull());

        // In the background: the failure first, then the clusters read before it.
        PgsqlManagerAsync async;
        QStringList log;
        watch(&async, &log);
        async.startReadClusters();
        QStringList expected{"clustersReaded(" + clusters + ')'};
        if (!message.isNull())
            expected.prepend("exceptionArise(" + message + ')');
        QTRY_COMPARE_WITH_TIMEOUT(log, expected, 35000);
    }

    void asynchronousReadsOneAtATime()
    {
        // Each read lists one cluster whose version counts the reads; a
        // receiver notes whether another read was running while it looked.
        FakePrograms fakes;
        fakes.add(QStringLiteral("pg_lsclusters"),
                  "dir=$(dirname \"$0\")\nn=$(( $(cat \"$dir/count\" 2>/dev/null || echo 0) + 1 ))\necho $n > \"$dir/count\"\n"
                  "touch \"$dir/reading\"\nsleep 0.3\nrm \"$dir/reading\"\necho \"$n main 5432 online postgres /a /b\"");
        auto *manager = new PgsqlManagerAsync;
        QStringList log;
        connect(manager, &PgsqlManagerAsync::clustersReaded, [&](const QList<PgsqlCluster *> &c) {
            log << describe(c) + (QFile::exists(fakes.filePath(QStringLiteral("reading"))) ? " during a read" : "");
        });

        // A refresh asked for after a read ended in the pool, but before its
        // completion reached this thread, waits for that completion.
        manager->startReadClusters();
        QDeadlineTimer deadline(35000);
        while (QThreadPool::globalInstance()->activeThreadCount() > 0 && !deadline.hasExpired())
            QThread::msleep(10);
        manager->startReadClusters();
        QTRY_COMPARE_WITH_TIMEOUT(log, (QStringList{"1/main:5432", "2/main:5432"}), 35000);

        // Requests during a read make one more read after it.
        manager->startReadClusters();
        manager->startReadClusters();
        manager->startReadClusters();
        QTRY_COMPARE_WITH_TIMEOUT(log.size(), 4, 35000);
        QTest::qWait(500);
        QCOMPARE(log.mid(2), (QStringList{"3/main:5432", "4/main:5432"}));

        manager->startReadClusters();
        QTRY_VERIFY(QFile::exists(fakes.filePath(QStringLiteral("reading"))));
        delete manager; // waits for the running read instead of leaving it a dead manager
        QCoreApplication::processEvents();
        QCOMPARE(log.size(), 4);
        QCOMPARE(fakes.read(QStringLiteral("count")), QByteArray("5\n"));
    }

    void realCluster()
    {
        // A throw-away cluster of our own (pg_createcluster picks a free port),
        // dropped again whatever happens.
        const QStringList versions = QDir(QStringLiteral("/usr/lib/postgresql")).entryList(QDir::Dirs | QDir::NoDotAndDotDot);
        if (geteuid() != 0 || versions.isEmpty() || QStandardPaths::findExecutable(QStringLiteral("pg_createcluster")).isEmpty())
            QSKIP("creating a PostgreSQL cluster needs root, a PostgreSQL server and pg_createcluster");
        const QString version = *std::max_element(versions.begin(), versions.end(),
                                                  [](const QString &a, const QString &b) { return a.toInt() < b.toInt(); });
        const QString name = QStringLiteral("kvttest_%1").arg(getpid());
        if (QProcess::execute(QStringLiteral("pg_createcluster"), {version, name}) != 0)
            QSKIP("pg_createcluster failed");
        const auto drop = qScopeGuard(
            [&] { QProcess::execute(QStringLiteral("pg_dropcluster"), {QStringLiteral("--stop"), version, name}); });

        PgsqlManager manager;
        manager.readClusters();
        PgsqlCluster *ours = nullptr;
        for (PgsqlCluster *c : manager.getClusters())
            ours = c->name() == name ? c : ours;
        QVERIFY2(ours, "the new cluster is not listed");
        QCOMPARE(ours->version() + ' ' + ours->owner(), version + " postgres");
        QVERIFY(!ours->isWork());
        ours->start();
        // Only the versioned server package counts, not postgresql-common or a client.
        QVERIFY(ours->isWork() && PgsqlManager().packagesInslled());

        const QString user = QStringLiteral("kvt_user_%1").arg(getpid());
        ours->createUser(user);
        const bool created = ours->usernames().contains(user);
        ours->deleteUser(user);
        QVERIFY(created && !ours->usernames().contains(user));
        // A statement the server rejects comes back with psql's message.
        const QString message = thrown([&] { ours->sqlRequest(QStringLiteral("create user select;")); });
        QVERIFY2(message.contains(QLatin1String("execute with error code")) && message.contains(QLatin1String("ERROR")),
                 qPrintable(message));
    }
};

QTEST_GUILESS_MAIN(PgsqlTest)
#include "tst_pgsql.moc"
