#include <kvt-common/controlservicetask.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/readpropertylightservicetask.h>
#include <kvt-common/reloadservicetask.h>
#include <kvt-common/restartservicetask.h>
#include <kvt-common/serviceelement.h>
#include <kvt-common/servicelightelementdata.h>
#include <kvt-common/startservicetask.h>
#include <kvt-common/stopservicetask.h>
#include <kvt-common/taskobserverdialog.h>

#include "../system/systemtest.h"
#include "../widget/editwidget.h"
#include "recordingmodule.h"
#include "taskprobe.h"

#include <QtTest>

#include <memory>


namespace {

// A service control program: records its arguments in "calls"; for the
// first argument <a> that has a file <a>.code it writes <a>.err (if any) to
// standard error and exits with the code in the file, or crashes when the
// file says "crash". Without such a file it exits with 0.
const QByteArray serviceScript = R"(d=$(dirname "$0")
echo "$*" >> "$d/calls"
for a in "$@"; do
  if [ -f "$d/$a.code" ]; then
    [ -f "$d/$a.err" ] && cat "$d/$a.err" >&2
    c=$(cat "$d/$a.code")
    [ "$c" = crash ] && kill -SEGV $$
    exit "$c"
  fi
done
exit 0)";

class Service : public TestElement<ServiceElement>
{
public:
    explicit Service(Module &module)
        : TestElement<ServiceElement>(module, rightsYes, QStringLiteral("service"), QStringLiteral("nginx"))
    {
    }
    quint64 availableOperations() const override { return ReadPropertyOperation; }
    void performOperation(OperationType type, ElementData *data, int flags) override
    {
        if (type == ReadPropertyOperation)
            _module.performOperation(this, type, data, flags);
    }
    QString state() const
    {
        auto *data = dynamic_cast<ServiceLightElementData *>(elementData());
        return data ? QStringLiteral("%1/%2").arg(data->state() ? "on" : "off", data->textState()) : QString();
    }
};

/*! Reads a service's state with a status task whenever asked. */
class ServicesModule : public RecordingModule
{
public:
    ServicesModule(QStringList *outcomes, const QString &program)
        : RecordingModule(QStringLiteral("services")), outcomes(outcomes), program(program)
    {
    }
    void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                          int flags) override
    {
        RecordingModule::performOperation(context, type, data, flags);
        delete data;
        if (type == ReadPropertyOperation)
            TaskObserver::instance()->performTask(setUp(new Probe<ReadPropertyLightServiceTask>(
                outcomes, context->elementContext())));
    }
    ServiceTask *setUp(ServiceTask *task) const
    {
        task->setProgram(program);
        task->setArguments({QStringLiteral("nginx")});
        return task;
    }
    QStringList *outcomes;
    QString program;
};

// "%E" in an expected outcome stands for the toolkit's error text.
void compareOutcome(const QString &actual, const QString &expected)
{
    QStringList parts = expected.split(QLatin1String("%E"));
    for (QString &part : parts)
        part = QRegularExpression::escape(part);
    const QString pattern = parts.join(QLatin1String(".+"));
    QVERIFY2(QRegularExpression(QStringLiteral("^%1$").arg(pattern)).match(actual).hasMatch(),
             qPrintable(QStringLiteral("%1\ndoes not match\n%2").arg(actual, expected)));
}

} // namespace

class ServiceTasksTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void cleanupTestCase();
    void init();
    void cleanup();

    void serviceCommands_data();
    void serviceCommands();
    void argumentsAfterCommand();
    void controlLaunches_data();
    void controlLaunches();
    void existPackage_data();
    void existPackage();
    void existPackageWithRealDatabase();

private:
    void settle() { QTRY_COMPARE_WITH_TIMEOUT(TaskObserver::instance()->runningCount(), 0, 15000); }
    void setCode(const QString &command, const QByteArray &code, const QByteArray &err = QByteArray())
    {
        QFile file(fakes->filePath(command + ".code"));
        QVERIFY(file.open(QIODevice::WriteOnly));
        file.write(code);
        if (!err.isEmpty()) {
            QFile errors(fakes->filePath(command + ".err"));
            QVERIFY(errors.open(QIODevice::WriteOnly));
            errors.write(err);
        }
    }

    Workers workers;
    ElementRootTreeNode *root = nullptr;
    std::unique_ptr<FakePrograms> fakes;
    QString program;
    QStringList outcomes;
    std::unique_ptr<ServicesModule> module;
    Service *nginx = nullptr;
    EditWidget *editor = nullptr;
};

void ServiceTasksTest::initTestCase()
{
    workers.start(2);
}

void ServiceTasksTest::cleanupTestCase()
{
    workers.stop();
    delete TaskObserver::instance();
}

void ServiceTasksTest::init()
{
    fakes.reset(new FakePrograms);
    program = fakes->add(QStringLiteral("svc"), serviceScript);
    outcomes.clear();
    module.reset(new ServicesModule(&outcomes, program));
    // Not what an earlier test left in the settings.
    module->moduleDataRef()->insert(QStringLiteral("paranoid"), false);
    root = new ElementRootTreeNode(module.get());
    nginx = new Service(*module);
    static_cast<ServiceLightElementData *>(nginx->elementData())->setState(false, QStringLiteral("unknown"));
    root->append(nginx);
    editor = new EditWidget(*module, rightsYes, QStringLiteral("service"));
    module->insertElementWidget(editor);
    editor->setElement(nginx, EditElementRole);
    module->log.clear();
}

void ServiceTasksTest::cleanup()
{
    settle();
    // Tree nodes do not own their children.
    root->clearDeleteAll();
    module.reset();
    fakes.reset();
    TaskObserverDialog *dialog = TaskObserver::instance()->dialog();
    if (dialog->isVisible())
        dialog->reject();
}

void ServiceTasksTest::serviceCommands_data()
{
    QTest::addColumn<QString>("command");
    QTest::addColumn<bool>("forceReread");
    QTest::addColumn<QByteArray>("code");
    QTest::addColumn<QStringList>("expectedOutcomes");
    QTest::addColumn<QString>("state");
    QTest::addColumn<int>("rereads");
    QTest::addColumn<QStringList>("hooks");

    const QStringList none;
    const QStringList shown{"read(service_nginx)"};
    // The status program says "stopped" (3) throughout, so a re-read shows.
    QTest::newRow("status of a running service") << "status" << false << QByteArray("0") << QStringList{"success"}
                                                 << "on/started" << 0 << none;
    QTest::newRow("status of a stopped service") << "status" << false << QByteArray("3") << QStringList{"success"}
                                                 << "off/stopped" << 0 << none;
    QTest::newRow("status program crashes")
        << "status" << false << QByteArray("crash")
        << QStringList{"fail: Process: \"%P status nginx\". Error: %E.\n\"Not finished\""} << "off/unknown" << 0
        << none;
    QTest::newRow("start") << "start" << false << QByteArray("0") << QStringList{"success"} << "on/started" << 0
                           << shown;
    QTest::newRow("start, force reread") << "start" << true << QByteArray("0")
                                         << QStringList{"success", "success"} << "off/stopped" << 1 << none;
    QTest::newRow("stop fails") << "stop" << false << QByteArray("1")
                                << QStringList{"fail: Process: \"%P stop nginx\". Exit code: 1.\n\"boom\""}
                                << "off/unknown" << 0 << none;
    QTest::newRow("stop fails, force reread")
        << "stop" << true << QByteArray("1")
        << QStringList{"fail: Process: \"%P stop nginx\". Exit code: 1.\n\"boom\"", "success"} << "off/stopped" << 1
        << none;
    QTest::newRow("restart") << "restart" << false << QByteArray("0") << QStringList{"success"} << "off/unknown" << 0
                             << none;
    QTest::newRow("restart fails") << "restart" << false << QByteArray("7")
                                   << QStringList{"fail: Process: \"%P restart nginx\". Exit code: 7.\n\"boom\"",
                                                  "success"}
                                   << "off/stopped" << 1 << none;
    QTest::newRow("reload, force reread") << "reload" << true << QByteArray("0")
                                          << QStringList{"success", "success"} << "off/stopped" << 1 << none;
}

void ServiceTasksTest::serviceCommands()
{
    QFETCH(QString, command);
    QFETCH(bool, forceReread);
    QFETCH(QByteArray, code);
    QFETCH(QStringList, expectedOutcomes);
    QFETCH(QString, state);
    QFETCH(int, rereads);
    QFETCH(QStringList, hooks);

    module->moduleDataRef()->insert(QStringLiteral("paranoid"), forceReread);
    if (command != QLatin1String("status"))
        setCode(QStringLiteral("status"), "3");
    setCode(command, code, "  boom\n");

    ServiceTask *task = nullptr;
    if (command == QLatin1String("status"))
        task = new Probe<ReadPropertyLightServiceTask>(&outcomes, nginx);
    else if (command == QLatin1String("start"))
        task = new Probe<StartServiceTask>(&outcomes, nginx);
    else if (command == QLatin1String("stop"))
        task = new Probe<StopServiceTask>(&outcomes, nginx);
    else if (command == QLatin1String("restart"))
        task = new Probe<RestartServiceTask>(&outcomes, nginx);
    else
        task = new Probe<ReloadServiceTask>(&outcomes, nginx);
    QCOMPARE(task->command(), command);
    QSignalSpy changed(nginx, SIGNAL(nodeDataChanged(TreeNode *)));
    TaskObserver::instance()->performTask(module->setUp(task));
    settle();

    QCOMPARE(outcomes.size(), expectedOutcomes.size());
    for (int i = 0; i < outcomes.size(); ++i)
        compareOutcome(outcomes.at(i), QString(expectedOutcomes.at(i)).replace(QLatin1String("%P"), program));
    QCOMPARE(nginx->state(), state);
    QCOMPARE(module->log.count(QStringLiteral("ReadProperty(service_nginx)")), rereads);
    QCOMPARE(editor->hooks, hooks);
    QCOMPARE(changed.isEmpty(), state == QLatin1String("off/unknown"));
}

void ServiceTasksTest::argumentsAfterCommand()
{
    ServiceTask *last = module->setUp(new Probe<StopServiceTask>(&outcomes, nginx));
    last->setCommandFirst(false);
    last->setArguments({QStringLiteral("nginx"), QStringLiteral("--now")});
    TaskObserver::instance()->performTask(last);
    settle();
    QCOMPARE(fakes->read(QStringLiteral("calls")), QByteArray("nginx --now stop\n"));

    // A program that cannot be found is named with its arguments.
    outcomes.clear();
    ServiceTask *missing = module->setUp(new Probe<StopServiceTask>(&outcomes, nginx));
    missing->setProgram(fakes->filePath(QStringLiteral("missing")));
    TaskObserver::instance()->performTask(missing);
    settle();
    QCOMPARE(outcomes.size(), 1);
    compareOutcome(outcomes.first(), QStringLiteral("fail: Process: \"%1 stop nginx\". Error: %E.\n\"Not started\"")
                                         .arg(fakes->filePath(QStringLiteral("missing"))));
}

void ServiceTasksTest::controlLaunches_data()
{
    QTest::addColumn<QString>("user");
    QTest::addColumn<QString>("programName");
    QTest::addColumn<QString>("outcome");
    QTest::addColumn<QByteArray>("launched");

    QTest::newRow("as the current user") << "" << "tool" << "success" << QByteArray("tool a b\n");
    QTest::newRow("through runuser") << "postgres" << "/bin/true" << "success"
                                     << QByteArray("runuser -u postgres /bin/true a b\n");
    QTest::newRow("missing program") << "" << "missing" << "fail: Failed to execute command \"%1 a b\"" << QByteArray();
}

void ServiceTasksTest::controlLaunches()
{
    QFETCH(QString, user);
    QFETCH(QString, programName);
    QFETCH(QString, outcome);
    QFETCH(QByteArray, launched);

    // Both record how they were started in "launched".
    fakes->add(QStringLiteral("tool"), R"(echo "tool $*" >> "$(dirname "$0")/launched")");
    fakes->add(QStringLiteral("runuser"), R"(echo "runuser $*" >> "$(dirname "$0")/launched")");
    const QString path = programName.startsWith(QLatin1Char('/')) ? programName : fakes->filePath(programName);

    auto *task = new Probe<ControlServiceTask>(&outcomes, nginx);
    task->setUser(user);
    task->setProgram(path);
    task->setArguments({QStringLiteral("a"), QStringLiteral("b")});
    TaskObserver::instance()->performTask(task);
    settle();
    QCOMPARE(outcomes, QStringList{outcome.contains(QLatin1String("%1")) ? outcome.arg(path) : outcome});
    if (launched.isEmpty())
        return;
    // Detached: the program may still be starting when the task has ended.
    QTRY_VERIFY(!fakes->read(QStringLiteral("launched")).isEmpty());
    QCOMPARE(fakes->read(QStringLiteral("launched")).replace(QFile::encodeName(path), "tool"),
             launched.replace(QFile::encodeName(path), "tool"));
}

void ServiceTasksTest::existPackage_data()
{
    QTest::addColumn<QByteArray>("script");
    QTest::addColumn<bool>("installed");

    QTest::newRow("installed") << QByteArray(R"(printf 'ii foo\n')") << true;
    QTest::newRow("removed, configuration left") << QByteArray(R"(printf 'rc foo\n')") << false;
    QTest::newRow("no blank after the status") << QByteArray(R"(printf 'iifoo\n')") << false;
    QTest::newRow("on a later line") << QByteArray(R"(printf 'un bar\nii foo\n')") << true;
    QTest::newRow("failed query") << QByteArray(R"(printf 'ii foo\n'; exit 1)") << false;
    QTest::newRow("crashed query") << QByteArray(R"(printf 'ii foo\n'; kill -SEGV $$)") << false;
    QTest::newRow("no dpkg-query") << QByteArray() << false;
}

void ServiceTasksTest::existPackage()
{
    QFETCH(QByteArray, script);
    QFETCH(bool, installed);

    fakes->useOnlyFakes();
    if (!script.isEmpty())
        fakes->add(QStringLiteral("dpkg-query"), R"(echo "$@" > "${0%/*}/asked"
)" + script);
    QCOMPARE(ControlServiceTask::existPackage(QStringLiteral("foo")), installed);
    if (!script.isEmpty())
        QCOMPARE(fakes->read(QStringLiteral("asked")),
                 QByteArray("--show --showformat=${db:Status-Abbrev}${binary:Package}\n foo\n"));
}

void ServiceTasksTest::existPackageWithRealDatabase()
{
    if (QStandardPaths::findExecutable(QStringLiteral("dpkg-query")).isEmpty())
        QSKIP("dpkg-query is not installed");
    QVERIFY(ControlServiceTask::existPackage(QStringLiteral("dpkg")));
    QVERIFY(!ControlServiceTask::existPackage(QStringLiteral("kvt-no-such-package")));
}

QTEST_MAIN(ServiceTasksTest)
#include "tst_servicetasks.moc"
