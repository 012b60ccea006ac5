#include <kvt-common/containerelement.h>
#include <kvt-common/createtask.h>
#include <kvt-common/deletetask.h>
#include <kvt-common/dummytask.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/exporthtmltask.h>
#include <kvt-common/exportwidgettask.h>
#include <kvt-common/importtask.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/previewdialog.h>
#include <kvt-common/printwidgettask.h>
#include <kvt-common/readcontenttask.h>
#include <kvt-common/readpropertyheavytask.h>
#include <kvt-common/stoppabledummytask.h>
#include <kvt-common/taskobserverdialog.h>
#include <kvt-common/updatetask.h>

#include "../widget/editwidget.h"
#include "dialoganswerer.h"
#include "recordingmodule.h"
#include "taskprobe.h"

#include <QMutex>
#include <QPointer>
#include <QTemporaryDir>
#include <QTextEdit>
#include <QtTest>

#include <memory>

using Container = TestElement<ContainerElement>;
using Ordinary = TestElement<OrdinaryElement>;

namespace {

/*!
 * What the tasks of the test module read and change: user names with a
 * text each. Tasks reach it from worker threads.
 */
struct FakeSystem
{
    QMutex mutex;
    QMap<QString, QString> users;
    bool failWrites = false;

    bool read(const QString &name, QString *text)
    {
        QMutexLocker lock(&mutex);
        if (!users.contains(name))
            return false;
        *text = users.value(name);
        return true;
    }
    bool write(const QString &name, const QString &text, bool mustExist)
    {
        QMutexLocker lock(&mutex);
        if (failWrites || users.contains(name) != mustExist)
            return false;
        users.insert(name, text);
        return true;
    }
    bool remove(const QString &name)
    {
        QMutexLocker lock(&mutex);
        return !failWrites && users.remove(name) == 1;
    }
    QStringList names()
    {
        QMutexLocker lock(&mutex);
        return users.keys();
    }
};

void finish(AbstractTask *task, bool ok, const QString &failure)
{
    task->taskDescription().setStatus(ok ? TaskDescription::Success : TaskDescription::Fail);
    if (!ok)
        task->taskDescription().setMessage(failure);
}

// The tasks of a plugin: each does its system work in run() and leaves the
// rest to the library's afterRun().

class ReadUser : public ReadPropertyHeavyTask
{
public:
    ReadUser(FakeSystem *system, Element *element)
        : ReadPropertyHeavyTask(element), system(system), name(element->title())
    {
    }
    void run() override
    {
        QString text;
        const bool ok = system->read(name, &text);
        if (ok) {
            _elementData = new ElementData;
            _elementData->insert(QStringLiteral("text"), text);
        }
        finish(this, ok, QStringLiteral("no user ") + name);
        AbstractTask::run();
    }
    FakeSystem *system;
    QString name;
};

class WriteUser : public UpdateTask
{
public:
    WriteUser(FakeSystem *system, Element *element, ElementData *data)
        : UpdateTask(element, data), system(system), name(element->title())
    {
    }
    void run() override
    {
        const QString text = _elementData ? _elementData->value(QStringLiteral("text")).toString() : QString();
        finish(this, system->write(name, text, true), QStringLiteral("cannot write ") + name);
        AbstractTask::run();
    }
    FakeSystem *system;
    QString name;
};

class MakeUser : public CreateTask
{
public:
    MakeUser(FakeSystem *system, Element *container, ElementData *data, bool addsElement)
        : CreateTask(container, data), system(system), addsElement(addsElement)
    {
    }
    void run() override
    {
        const QString name = _elementData ? _elementData->name() : QString();
        finish(this, !name.isEmpty() && system->write(name, name, false), QStringLiteral("cannot create"));
        AbstractTask::run();
    }
    void afterRun() override
    {
        // Without force reread a plugin lists the new element itself.
        if (addsElement && taskDescription().status() == TaskDescription::Success) {
            _element->append(new Ordinary(_element->module(), rightsYes, QStringLiteral("user"),
                                          _elementData->name()));
        }
        CreateTask::afterRun();
    }
    FakeSystem *system;
    bool addsElement;
};

class ListUsers : public ReadContentTask
{
public:
    ListUsers(FakeSystem *system, Element *container, ElementData *created)
        : ReadContentTask(container), system(system)
    {
        _elementData = created;
    }
    void run() override
    {
        names = system->names();
        finish(this, true, QString());
        AbstractTask::run();
    }
    void afterRun() override
    {
        _element->clearDelete();
        for (const QString &name : qAsConst(names))
            _element->append(new Ordinary(_element->module(), rightsYes, QStringLiteral("user"), name));
        ReadContentTask::afterRun();
    }
    FakeSystem *system;
    QStringList names;
};

class RemoveUser : public DeleteTask
{
public:
    RemoveUser(FakeSystem *system, Element *element)
        : DeleteTask(element), system(system), name(element->title())
    {
    }
    void run() override
    {
        finish(this, system->remove(name), QStringLiteral("cannot remove ") + name);
        AbstractTask::run();
    }
    FakeSystem *system;
    QString name;
};

/*!
 * A plugin's module: every operation on its users becomes one of the tasks
 * above. A creation asked for by a widget goes under the "users" container.
 */
class UsersModule : public RecordingModule
{
public:
    UsersModule(FakeSystem *system, QStringList *outcomes)
        : RecordingModule(QStringLiteral("users"))
        , system(system)
        , outcomes(outcomes)
    {
    }

    void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                          int flags) override
    {
        RecordingModule::performOperation(context, type, data, flags);
        Element *element = context ? context->elementContext() : nullptr;
        AbstractTask *task = nullptr;
        switch (type) {
        case ReadPropertyOperation:
            task = new Probe<ReadUser>(outcomes, system, element);
            break;
        case UpdateOperation:
            task = new Probe<WriteUser>(outcomes, system, element, data);
            break;
        case CreateOperation:
            task = new Probe<MakeUser>(outcomes, system, element ? element : container, data,
                                       !getData(QStringLiteral("paranoid")).toBool());
            break;
        case ReadContentOperation:
            task = new Probe<ListUsers>(outcomes, system, element, data);
            break;
        case DeleteOperation:
            task = new Probe<RemoveUser>(outcomes, system, element);
            break;
        default:
            delete data;
            return;
        }
        TaskObserver::instance()->performTask(task);
    }

    void setForceReread(const QString &mode)
    {
        if (mode == QLatin1String("absent"))
            moduleDataRef()->remove(QStringLiteral("paranoid"));
        else
            moduleDataRef()->insert(QStringLiteral("paranoid"), mode == QLatin1String("true"));
    }

    FakeSystem *system;
    QStringList *outcomes;
    Element *container = nullptr;
};

QList<int> states(const QSignalSpy &spy)
{
    QList<int> result;
    for (const QList<QVariant> &arguments : spy)
        result.append(arguments.value(0).toInt());
    return result;
}

QStringList titles(const TreeNode *node)
{
    QStringList result;
    for (TreeNode *child : node->childNodes())
        result.append(qobject_cast<Element *>(child)->title());
    return result;
}

} // namespace

class ElementTasksTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void cleanupTestCase();
    void init();
    void cleanup();

    void readEditApply_data();
    void readEditApply();
    void failedReadKeepsWidgetBlocked();
    void create_data();
    void create();
    void deleteElement_data();
    void deleteElement();
    void importIntoWidget_data();
    void importIntoWidget();
    void exportConfirmed_data();
    void exportConfirmed();
    void printThroughStylesheet_data();
    void printThroughStylesheet();
    void exportHtml_data();
    void exportHtml();
    void dummyTasks();

private:
    void settle() { QTRY_COMPARE_WITH_TIMEOUT(TaskObserver::instance()->runningCount(), 0, 15000); }

    Workers workers;
    FakeSystem system;
    QStringList outcomes;
    std::unique_ptr<UsersModule> module;
    Container *users = nullptr;
    Ordinary *alice = nullptr;
    EditWidget *editor = nullptr;  // edits users
    EditWidget *creator = nullptr; // creates users under the container
    QTemporaryDir dir;
};

void ElementTasksTest::initTestCase()
{
    qRegisterMetaType<TreeNode *>();
    workers.start(3);
}

void ElementTasksTest::cleanupTestCase()
{
    workers.stop();
    delete PreviewDialog::instance();
    delete TaskObserver::instance();
}

void ElementTasksTest::init()
{
    {
        QMutexLocker lock(&system.mutex);
        system.users = {{QStringLiteral("alice"), QStringLiteral("likes tea")}};
        system.failWrites = false;
    }
    outcomes.clear();
    module.reset(new UsersModule(&system, &outcomes));
    auto *root = new ElementRootTreeNode(module.get());
    users = new Container(*module, rightsYes, QStringLiteral("users"), QStringLiteral("users"));
    alice = new Ordinary(*module, rightsYes, QStringLiteral("user"), QStringLiteral("alice"));
    root->append(users);
    users->append(alice);
    module->container = users;
    editor = new EditWidget(*module, rightsYes, QStringLiteral("user"));
    creator = new EditWidget(*module, rightsYes, QStringLiteral("users"));
    module->insertElementWidget(editor);
    module->insertElementWidget(creator);
    module->log.clear();
}

void ElementTasksTest::cleanup()
{
    settle();
    module.reset();
    TaskObserverDialog *dialog = TaskObserver::instance()->dialog();
    if (dialog->isVisible())
        dialog->reject();
}

void ElementTasksTest::readEditApply_data()
{
    QTest::addColumn<QString>("forceReread");
    QTest::addColumn<bool>("writeFails");
    QTest::addColumn<QStringList>("operations");
    QTest::addColumn<QStringList>("hooks");
    QTest::addColumn<QList<int>>("reported");
    QTest::addColumn<QString>("shownText");
    QTest::addColumn<QStringList>("expectedOutcomes");

    const QStringList readUpdateRead{"ReadProperty(user_alice)", "Update(user_alice)", "ReadProperty(user_alice)"};
    const QStringList readUpdate{"ReadProperty(user_alice)", "Update(user_alice)"};
    const QStringList readTwice{"read(user_alice)", "read(user_alice)"};
    const QString failure = QStringLiteral("fail: cannot write alice");

    // Without a stored "false" the update is checked by reading back.
    QTest::newRow("no force reread value") << "absent" << false << readUpdateRead << readTwice
                                           << QList<int>{3, 0} << "drinks coffee"
                                           << QStringList{"success", "success", "success"};
    QTest::newRow("force reread") << "true" << false << readUpdateRead << readTwice << QList<int>{3, 0}
                                  << "drinks coffee" << QStringList{"success", "success", "success"};
    QTest::newRow("trusting") << "false" << false << readUpdate
                              << QStringList{"read(user_alice)", "update"} << QList<int>{3, 0}
                              << "drinks coffee" << QStringList{"success", "success"};
    // A failed update is read back too, which shows the system's state.
    QTest::newRow("force reread, failed") << "true" << true << readUpdateRead << readTwice << QList<int>{3, 0}
                                          << "likes tea" << QStringList{"success", failure, "success"};
    QTest::newRow("trusting, failed keeps the change") << "false" << true << readUpdate
                                                      << QStringList{"read(user_alice)"} << QList<int>{3}
                                                      << "drinks coffee" << QStringList{"success", failure};
}

void ElementTasksTest::readEditApply()
{
    QFETCH(QString, forceReread);
    QFETCH(bool, writeFails);
    QFETCH(QStringList, operations);
    QFETCH(QStringList, hooks);
    QFETCH(QList<int>, reported);
    QFETCH(QString, shownText);
    QFETCH(QStringList, expectedOutcomes);

    module->setForceReread(forceReread);
    editor->setElement(alice, EditElementRole);
    QSignalSpy content(editor, SIGNAL(contentChanged(int)));
    editor->show();
    settle();
    QCOMPARE(editor->edit->text(), QStringLiteral("likes tea"));
    QVERIFY(editor->isEnabled());
    QVERIFY(!editor->isChanged());

    system.failWrites = writeFails;
    editor->userTypes(QStringLiteral("drinks coffee"));
    editor->applyContentChanges();
    settle();

    QCOMPARE(module->log, operations);
    QCOMPARE(editor->hooks, hooks);
    QCOMPARE(states(content), reported);
    QCOMPARE(editor->edit->text(), shownText);
    QCOMPARE(editor->isChanged(), reported.last() != 0);
    QCOMPARE(outcomes, expectedOutcomes);
    QString stored;
    QVERIFY(system.read(QStringLiteral("alice"), &stored));
    QCOMPARE(stored, writeFails ? QStringLiteral("likes tea") : QStringLiteral("drinks coffee"));
    editor->hide();
}

void ElementTasksTest::failedReadKeepsWidgetBlocked()
{
    system.users.clear();
    editor->setElement(alice, EditElementRole);
    editor->show();
    settle();
    QCOMPARE(outcomes, QStringList{"fail: no user alice"});
    QVERIFY(!editor->isEnabled());
    QVERIFY(editor->isEditBlocked());
    QCOMPARE(editor->hooks, QStringList{});
    editor->hide();
}

void ElementTasksTest::create_data()
{
    QTest::addColumn<QString>("forceReread");
    QTest::addColumn<QString>("name");
    QTest::addColumn<QStringList>("operations");
    QTest::addColumn<QStringList>("listed");
    QTest::addColumn<QString>("madeCurrent");
    QTest::addColumn<QList<int>>("reported");

    // The created element is listed by the plugin, and the creation widget
    // is cleared.
    QTest::newRow("trusting") << "false" << "carol" << QStringList{"Create(widget)"}
                              << QStringList{"alice", "carol"} << "" << QList<int>{2, 3, 0};
    QTest::newRow("no force reread value") << "absent" << "carol" << QStringList{"Create(widget)"}
                                           << QStringList{"alice", "carol"} << "" << QList<int>{2, 3, 0};
    // The container is read again and selects the new element by name.
    QTest::newRow("force reread") << "true" << "carol"
                                  << QStringList{"Create(widget)", "ReadContent(users_users)"}
                                  << QStringList{"alice", "carol"} << "carol" << QList<int>{2, 3};
    QTest::newRow("trusting, failed") << "false" << "alice" << QStringList{"Create(widget)"}
                                      << QStringList{"alice"} << "" << QList<int>{2, 3};
    QTest::newRow("force reread, failed") << "true" << "alice"
                                          << QStringList{"Create(widget)", "ReadContent(users_users)"}
                                          << QStringList{"alice"} << "" << QList<int>{2, 3};
}

void ElementTasksTest::create()
{
    QFETCH(QString, forceReread);
    QFETCH(QString, name);
    QFETCH(QStringList, operations);
    QFETCH(QStringList, listed);
    QFETCH(QString, madeCurrent);
    QFETCH(QList<int>, reported);

    module->setForceReread(forceReread);
    QSignalSpy current(users, SIGNAL(setCurrentNode(TreeNode *)));
    QSignalSpy content(creator, SIGNAL(contentChanged(int)));
    // As the element widget container does for a creation.
    creator->setElement(nullptr, CreateElementRole);
    creator->userTypes(name);
    creator->applyContentChanges();
    settle();

    // Insertions are announced to the module as well; only the requests count here.
    QStringList requests = module->log.filter(QRegularExpression(QStringLiteral("^(Create|ReadContent)")));
    QCOMPARE(requests, operations);
    QCOMPARE(titles(users), listed);
    QStringList currentIds;
    for (const QList<QVariant> &arguments : current)
        currentIds.append(arguments.first().value<TreeNode *>()->id());
    QCOMPARE(currentIds, madeCurrent.isEmpty() ? QStringList{} : QStringList{"user_" + madeCurrent});
    QCOMPARE(states(content), reported);
}

void ElementTasksTest::deleteElement_data()
{
    QTest::addColumn<QString>("forceReread");
    QTest::addColumn<bool>("fails");
    QTest::addColumn<bool>("stillListed");
    QTest::addColumn<int>("parentMadeCurrent");

    QTest::newRow("trusting") << "false" << false << false << 1;
    QTest::newRow("no force reread value") << "absent" << false << false << 1;
    // The element stays until its container is read again.
    QTest::newRow("force reread") << "true" << false << true << 1;
    QTest::newRow("trusting, failed") << "false" << true << true << 0;
    QTest::newRow("force reread, failed") << "true" << true << true << 1;
}

void ElementTasksTest::deleteElement()
{
    QFETCH(QString, forceReread);
    QFETCH(bool, fails);
    QFETCH(bool, stillListed);
    QFETCH(int, parentMadeCurrent);

    module->setForceReread(forceReread);
    system.failWrites = fails;
    QPointer<Ordinary> element = alice;
    QSignalSpy current(users, SIGNAL(setCurrentNode(TreeNode *)));
    alice->performOperation(DeleteOperation, nullptr, 0);
    settle();

    QCOMPARE(current.count(), parentMadeCurrent);
    QCOMPARE(titles(users), stillListed ? QStringList{"alice"} : QStringList{});
    QCOMPARE(bool(element), stillListed);
    QCOMPARE(module->log.contains(QStringLiteral("Removed(user_alice)")), !stillListed);
}

void ElementTasksTest::importIntoWidget_data()
{
    QTest::addColumn<bool>("succeeds");
    QTest::addColumn<QStringList>("hooks");
    QTest::addColumn<QList<int>>("reported");

    QTest::newRow("imported") << true << QStringList{"import(from file)"} << QList<int>{3};
    QTest::newRow("failed") << false << QStringList{} << QList<int>{};
}

void ElementTasksTest::importIntoWidget()
{
    QFETCH(bool, succeeds);
    QFETCH(QStringList, hooks);
    QFETCH(QList<int>, reported);

    class Import : public ImportTask
    {
    public:
        Import(ElementWidget *widget, ElementData *data, bool succeeds)
            : ImportTask(widget, data), succeeds(succeeds)
        {
        }
        void run() override
        {
            finish(this, succeeds, QStringLiteral("unreadable"));
            AbstractTask::run();
        }
        bool succeeds;
    };

    editor->setElement(alice, EditElementRole);
    QSignalSpy content(editor, SIGNAL(contentChanged(int)));
    auto *data = new ElementData;
    data->insert(QStringLiteral("text"), QStringLiteral("from file"));
    TaskObserver::instance()->performTask(new Import(editor, data, succeeds));
    settle();
    QCOMPARE(editor->hooks, hooks);
    QCOMPARE(states(content), reported);
}

void ElementTasksTest::exportConfirmed_data()
{
    QTest::addColumn<bool>("succeeds");
    QTest::addColumn<QStringList>("boxes");

    QTest::newRow("exported") << true
                              << QStringList{QStringLiteral("Export|Export success!|%1").arg(int(QMessageBox::Ok))};
    QTest::newRow("failed") << false << QStringList{};
}

void ElementTasksTest::exportConfirmed()
{
    QFETCH(bool, succeeds);
    QFETCH(QStringList, boxes);

    class Export : public ExportWidgetTask
    {
    public:
        Export(ElementWidget *widget, bool succeeds) : ExportWidgetTask(widget, nullptr), succeeds(succeeds) {}
        void run() override
        {
            finish(this, succeeds, QStringLiteral("disk full"));
            AbstractTask::run();
        }
        bool succeeds;
    };

    DialogAnswerer answerer;
    answerer.answer(QMessageBox::Ok);
    TaskObserver::instance()->performTask(new Export(editor, succeeds));
    settle();
    QCOMPARE(answerer.seen, boxes);
}

void ElementTasksTest::printThroughStylesheet_data()
{
    QTest::addColumn<QString>("stylesheet");
    QTest::addColumn<QString>("xml");
    QTest::addColumn<QString>("outcome");
    QTest::addColumn<QString>("shown");

    const QString sheet = QStringLiteral("report.xsl");
    const QString xml = QStringLiteral("<users><user>alice</user><user>b&amp;b</user></users>");
    const QString failure = QStringLiteral("fail: Internal error: XML transformation failed");
    QTest::newRow("transformed") << sheet << xml << "success" << "alice;b&b;";
    QTest::newRow("missing stylesheet") << "missing.xsl" << xml << failure << "";
    QTest::newRow("no stylesheet named") << "" << xml << failure << "";
    QTest::newRow("broken document") << sheet << "<users><user>" << failure << "";
}

void ElementTasksTest::printThroughStylesheet()
{
    QFETCH(QString, stylesheet);
    QFETCH(QString, xml);
    QFETCH(QString, outcome);
    QFETCH(QString, shown);

    QFile sheet(dir.filePath(QStringLiteral("report.xsl")));
    QVERIFY(sheet.open(QIODevice::WriteOnly | QIODevice::Truncate));
    sheet.write(R"(<xsl:stylesheet version="2.0" xmlns:xsl="http://www.w3.org/1999/XSL/Transform">
  <xsl:template match="/">
    <html><body><p><xsl:for-each select="users/user"><xsl:value-of select="."/>;</xsl:for-each></p></body></html>
  </xsl:template>
</xsl:stylesheet>
)");
    sheet.close();

    auto *data = new ElementData;
    data->insert(QStringLiteral("xmlText"), xml);
    if (!stylesheet.isEmpty())
        data->insert(QStringLiteral("templateName"), QUrl::fromLocalFile(dir.filePath(stylesheet)).toString());

    DialogAnswerer answerer;
    QString previewed;
    answerer.inspect = [&previewed](QDialog *dialog) {
        previewed = dialog->findChild<QTextEdit *>(QStringLiteral("_previewTextEdit"))->toPlainText();
    };
    TaskObserver::instance()->performTask(new Probe<PrintWidgetTask>(&outcomes, editor, data));
    settle();

    QCOMPARE(outcomes, QStringList{outcome});
    QCOMPARE(answerer.seen, shown.isEmpty() ? QStringList{} : QStringList{"dialog:PreviewDialog"});
    QCOMPARE(previewed.trimmed(), shown);
}

void ElementTasksTest::exportHtml_data()
{
    QTest::addColumn<QString>("path");
    QTest::addColumn<bool>("written");

    QTest::newRow("new file") << "report.html" << true;
    QTest::newRow("missing folder") << "missing/report.html" << false;
    QTest::newRow("no file named") << "" << false;
}

void ElementTasksTest::exportHtml()
{
    QFETCH(QString, path);
    QFETCH(bool, written);

    const QString html = QStringLiteral("<p>Отчёт &amp; report</p>");
    const QString file = path.isEmpty() ? QString() : dir.filePath(path);
    auto *data = new ElementData;
    if (!file.isEmpty())
        data->insert(QStringLiteral("filePath"), file);
    data->insert(QStringLiteral("htmlText"), html);
    auto *task = new Probe<ExportHtmlTask>(&outcomes, data);
    QCOMPARE(task->taskDescription().description(), QStringLiteral("Export to HTML"));
    TaskObserver::instance()->performTask(task);
    settle();

    QCOMPARE(outcomes.size(), 1);
    if (written) {
        QCOMPARE(outcomes.first(), QStringLiteral("success"));
        QFile result(file);
        QVERIFY(result.open(QIODevice::ReadOnly));
        QCOMPARE(result.readAll(), html.toUtf8());
        return;
    }
    // The name, the error code and the error text on lines of their own.
    const QStringList lines = outcomes.first().split(QLatin1Char('\n'));
    QCOMPARE(lines.size(), 2);
    QCOMPARE(lines.at(0), QStringLiteral("fail: \"%1\" error %2").arg(file).arg(int(QFileDevice::OpenError)));
    QVERIFY(!lines.at(1).isEmpty());
}

void ElementTasksTest::dummyTasks()
{
    auto *succeeding = new Probe<DummyTask>(&outcomes, alice, true);
    auto *failing = new Probe<DummyTask>(&outcomes, alice, false);
    auto *stoppable = new Probe<StoppableDummyTask>(&outcomes, alice);
    QCOMPARE(succeeding->taskDescription().description(), QStringLiteral("Dummy task"));
    QCOMPARE(stoppable->taskDescription().description(), QStringLiteral("Stoppable dummy task"));
    QCOMPARE(succeeding->taskSpecialFlags(), quint64(0));
    QCOMPARE(stoppable->taskSpecialFlags(), quint64(1));

    QElapsedTimer clock;
    clock.start();
    TaskObserver::instance()->performTask(succeeding);
    TaskObserver::instance()->performTask(failing);
    TaskObserver::instance()->performTask(stoppable);
    // A stop asked for during the first pause ends the task after it.
    QTest::qWait(500);
    QVERIFY(stoppable->setTaskAboutToBeStopped());
    settle();
    QVERIFY(clock.elapsed() >= 4900);
    QVERIFY(clock.elapsed() < 9000);
    outcomes.sort();
    QCOMPARE(outcomes, (QStringList{"fail: ERROR!!!\nERROR!!!\nERROR!!!\nERROR!!!\n", "fail: Terminate by user",
                                    "success"}));
}

QTEST_MAIN(ElementTasksTest)
#include "tst_elementtasks.moc"
