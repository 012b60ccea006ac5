// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/controlservicetask.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/readpropertylightservicetask.h>
#include <kvt-common/restartservicetask.h>
#include <kvt-common/serviceelement.h>
#include <kvt-common/servicelightelementdata.h>
#include <kvt-common/startservicetask.h>
#include <kvt-common/taskobserverdialog.h>

#include "../system/systemtest.h"
#include "../widget/editwidget.h"
#include "recordingmodule.h"
#include "taskprobe.h"

#include <QtTest>

#include <memory>

namespace {

// A service control program: records its arguments in "calls"; when there
// is a file <command>.code it writes "boom" to standard error and exits with
// the code in the file, or crashes when the file says "crash".
const QByteArray serviceScript = R"(d=${0%/*}
echo "$*" >> "$d/calls"
[ -f "$d/$1.code" ] || exit 0
echo "  boom" >&2
c=$(cat "$d/$1.code")
[ "$c" = crash ] && kill -SEGV $$
exit "$c")";

// A service whose state is read with a status task whenever asked, which the
// service tasks do after a change.
class Service : public TestElement<ServiceElement>
{
public:
    Service(Module &module, QStringList *outcomes, const QString &program)
        : TestElement<ServiceElement>(module, rightsYes, QStringLiteral("service"), QStringLiteral("nginx"))
        , outcomes(outcomes), program(program)
    {
        static_cast<ServiceLightElementData *>(elementData())->setState(false, QStringLiteral("unknown"));
    }
    quint64 availableOperations() const override { return ReadPropertyOperation; }
    void performOperation(OperationType, ElementData *data, int) override
    {
        delete data;
        TaskObserver::instance()->performTask(probe<ReadPropertyLightServiceTask>());
    }
    template <class Task>
    ServiceTask *probe()
    {
        ServiceTask *task = new Probe<Task>(outcomes, this);
        task->setProgram(program);
        task->setArguments({QStringLiteral("nginx")});
        return task;
    }
    QString state() const
    {
        auto *data = dynamic_cast<ServiceLightElementData *>(elementData());
        return QStringLiteral("%1/%2").arg(data->state() ? "on" : "off", data->textState());
    }
    QStringList *outcomes;
    QString program;
};

} // namespace

class ServiceTasksTest : public QObject
{
    Q_OBJECT

    Workers workers;
    ElementRootTreeNode *root = nullptr;
    std::unique_ptr<FakePrograms> fakes;
    QStringList outcomes;
    std::unique_ptr<RecordingModule> module;
    Service *nginx = nullptr;
    EditWidget *editor = nullptr;

    void run(AbstractTask *task)
    {
        TaskObserver::instance()->performTask(task);
        QTRY_COMPARE_WITH_TIMEOUT(TaskObserver::instance()->runningCount(), 0, 15000);
    }

private Q_SLOTS:
    void initTestCase() { workers.start(2); }
    void cleanupTestCase()
    {
        workers.stop();
        delete TaskObserver::instance();
    }
    void init()
    {
        fakes.reset(new FakePrograms);
        module.reset(new RecordingModule(QStringLiteral("services")));
        root = new ElementRootTreeNode(module.get());
        root->append(nginx = new Service(*module, &outcomes, fakes->add(QStringLiteral("svc"), serviceScript)));
        module->insertElementWidget(editor = new EditWidget(*module, rightsYes, QStringLiteral("service")));
        editor->setElement(nginx, EditElementRole);
    }
    void cleanup()
    {
        // Tree nodes do not own their children.
        root->clearDeleteAll();
        module.reset();
        fakes.reset();
        outcomes.clear();
        TaskObserver::instance()->dialog()->hide();
    }

    void serviceCommands_data()
    {
        QTest::addColumn<QString>("command");
        QTest::addColumn<QByteArray>("code");
        // "<task outcomes> | <service state> | <editor hooks> | <command lines run>", with
        // "%P" for the program and "%E" for the toolkit's error text.
        QTest::addColumn<QString>("expected");

        // The status program says "stopped" (3) throughout, so a re-read shows.
        QTest::newRow("status of a running service") << "status" << QByteArray("0")
                                                     << "success | on/started |  | status nginx";
        QTest::newRow("status program crashes")
            << "status" << QByteArray("crash")
            << "fail: Process: \"%P status nginx\". Error: %E.\n\"Not finished\" | off/unknown |  | status nginx";
        QTest::newRow("start") << "start" << QByteArray("0")
                               << "success | on/started | read(service_nginx) | start nginx";
        // A failed restart or reload reads the state again, even when trusting.
        QTest::newRow("restart fails") << "restart" << QByteArray("7")
                                       << "fail: Process: \"%P restart nginx\". Exit code: 7.\n\"boom\", success | "
                                          "off/stopped |  | restart nginx, status nginx";
    }
    void serviceCommands()
    {
        QFETCH(QString, command);
        QFETCH(QByteArray, code);
        QFETCH(QString, expected);

        module->moduleDataRef()->insert(QStringLiteral("paranoid"), false);
        writeFile(fakes->filePath(QStringLiteral("status.code")), command == "status" ? code : "3");
        writeFile(fakes->filePath(command + ".code"), code);
        ServiceTask *task = command == "status" ? nginx->probe<ReadPropertyLightServiceTask>()
            : command == "start"                ? nginx->probe<StartServiceTask>()
                                                : nginx->probe<RestartServiceTask>();
        expected.replace(QLatin1String("%P"), task->program());
        QSignalSpy changed(nginx, SIGNAL(nodeDataChanged(TreeNode *)));
        run(task);
        const QString actual = QStringList{outcomes.join(QLatin1String(", ")), nginx->state(), editor->hooks.join(' '),
                                           QString(fakes->read(QStringLiteral("calls"))).trimmed().replace('\n', ", ")}
                                   .join(QLatin1String(" | "));
        const QString pattern = QRegularExpression::escape(expected).replace(QStringLiteral("\\%E"), ".+");
        QVERIFY2(QRegularExpression(QRegularExpression::anchoredPattern(pattern)).match(actual).hasMatch(),
                 qPrintable(actual));
        // The views hear of every change of the shown state.
        QCOMPARE(changed.isEmpty(), nginx->state() == QLatin1String("off/unknown"));
    }

    void controlLaunches_data()
    {
        QTest::addColumn<QString>("user");
        QTest::addColumn<QString>("program");
        QTest::addColumn<QString>("outcome"); // "%P" for the program
        QTest::addColumn<QByteArray>("launched");

        QTest::newRow("through runuser") << "postgres" << "/bin/true" << "success"
                                         << QByteArray("runuser -u postgres /bin/true a b\n");
        QTest::newRow("missing program") << "" << "missing" << "fail: Failed to execute command \"%P a b\""
                                         << QByteArray();
    }
    void controlLaunches()
    {
        QFETCH(QString, user);
        QFETCH(QString, program);
        QFETCH(QString, outcome);
        QFETCH(QByteArray, launched);

        // Records how it was started in "launched".
        fakes->add(QStringLiteral("runuser"), "echo \"${0##*/} $*\" >> \"${0%/*}/launched\"");
        auto *task = new Probe<ControlServiceTask>(&outcomes, nginx);
        task->setUser(user);
        task->setProgram(program.startsWith('/') ? program : fakes->filePath(program));
        task->setArguments({QStringLiteral("a"), QStringLiteral("b")});
        outcome.replace(QLatin1String("%P"), task->program());
        run(task);
        QCOMPARE(outcomes, QStringList{outcome});
        // Detached: the program may still be starting when the task has ended.
        QTRY_COMPARE(fakes->read(QStringLiteral("launched")), launched);
    }

    void existPackage_data()
    {
        QTest::addColumn<QByteArray>("script"); // the fake dpkg-query; none: the system's
        QTest::addColumn<QString>("package");
        QTest::addColumn<bool>("installed");

        QTest::newRow("removed, configuration left") << QByteArray("printf 'rc foo\\n'") << "foo" << false;
        QTest::newRow("on a later line") << QByteArray("printf 'un bar\\nii foo\\n'") << "foo" << true;
        // Names are matched as written; dpkg-query's wildcards keep their meaning.
        QTest::newRow("regexp characters in the name") << QByteArray("printf 'ii libstdc++6:amd64\\n'") << "libstdc++6" << true;
        QTest::newRow("a dot is no wildcard") << QByteArray("printf 'ii abc\\n'") << "a.c" << false;
        QTest::newRow("wildcards") << QByteArray("printf 'un postgresql-9.1\\nii postgresql-15\\n'") << "postgresql-[0-9]?*"
                                   << true;
        QTest::newRow("real database, installed") << QByteArray() << "libstdc++6" << true;
        QTest::newRow("real database, unknown") << QByteArray() << "kvt-no-such-package" << false;
    }
    void existPackage()
    {
        QFETCH(QByteArray, script);
        QFETCH(QString, package);

        if (!script.isEmpty())
            fakes->add(QStringLiteral("dpkg-query"), script);
        else if (QStandardPaths::findExecutable(QStringLiteral("dpkg-query")).isEmpty())
            QSKIP("dpkg-query is not installed");
        QTEST(ControlServiceTask::existPackage(package), "installed");
    }
};

QTEST_MAIN(ServiceTasksTest)
#include "tst_servicetasks.moc"
