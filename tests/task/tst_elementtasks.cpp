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
 * The "system" the test plugin administers: user names with a text each.
 * Tasks reach it from worker threads, under the lock.
 */
struct FakeSystem
{
    QMutex mutex;
    QMap<QString, QString> users;
    bool failWrites = false;
};

/*!
 * A plugin's task: run() does its work on the fake system (false fails the
 * task with "cannot <what>"); afterRun() runs \a before, as a plugin's
 * override would, and then the library's.
 */
template <class Base>
class UserTask : public Base
{
public:
    using Work = std::function<bool(UserTask *, FakeSystem *)>;

    template <class... Args>
    UserTask(FakeSystem *system, const QString &what, Work work, Args &&...args)
        : Base(std::forward<Args>(args)...), system(system), what(what), work(std::move(work))
    {
    }
    void run() override
    {
        QMutexLocker lock(&system->mutex);
        const bool ok = work(this, system);
        lock.unlock();
        this->taskDescription().setStatus(ok ? TaskDescription::Success : TaskDescription::Fail);
        if (!ok)
            this->taskDescription().setMessage(QStringLiteral("cannot ") + what);
        AbstractTask::run();
    }
    void afterRun() override
    {
        if (before && this->taskDescription().status() == TaskDescription::Success)
            before(this);
        Base::afterRun();
    }
    ElementData *&data() { return this->_elementData; }

    FakeSystem *system;
    QString what;
    Work work;
    std::function<void(UserTask *)> before;
    QStringList names;
};

/*!
 * A plugin's module: every operation on its users becomes a task. A
 * creation asked for by a widget goes under the "users" container.
 */
class UsersModule : public RecordingModule
{
public:
    UsersModule(FakeSystem *system, QStringList *outcomes)
        : RecordingModule(QStringLiteral("users")), system(system), outcomes(outcomes)
    {
    }

    template <class Base, class... Args>
    UserTask<Base> *make(const QString &what, typename UserTask<Base>::Work work, Args &&...args)
    {
        return new Probe<UserTask<Base>>(outcomes, system, what, std::move(work), std::forward<Args>(args)...);
    }

    void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                          int flags) override
    {
        RecordingModule::performOperation(context, type, data, flags);
        Element *element = context ? context->elementContext() : nullptr;
        const QString name = element ? element->title() : QString();
        AbstractTask *task = nullptr;
        if (type == ReadPropertyOperation) {
            task = make<ReadPropertyHeavyTask>("read " + name, [name](auto *task, FakeSystem *system) {
                if (!system->users.contains(name))
                    return false;
                task->data() = new ElementData;
                task->data()->insert(QStringLiteral("text"), system->users.value(name));
                return true;
            }, element);
        } else if (type == UpdateOperation) {
            task = make<UpdateTask>("write " + name, [name](auto *task, FakeSystem *system) {
                if (system->failWrites)
                    return false;
                system->users.insert(name, task->data()->value(QStringLiteral("text")).toString());
                return true;
            }, element, data);
        } else if (type == CreateOperation) {
            auto *create = make<CreateTask>("create", [](auto *task, FakeSystem *system) {
                const QString created = task->data()->name();
                if (system->users.contains(created))
                    return false;
                system->users.insert(created, created);
                return true;
            }, element ? element : container, data);
            // Without force reread a plugin lists the new element itself.
            if (!getData(QStringLiteral("paranoid")).toBool())
                create->before = [](auto *task) { task->element()->append(newUser(task->data()->name())); };
            task = create;
        } else if (type == ReadContentOperation) {
            auto *list = make<ReadContentTask>("list", [](auto *task, FakeSystem *system) {
                task->names = system->users.keys();
                return true;
            }, element);
            list->data() = data; // the name of a created element, if any
            list->before = [](auto *task) {
                task->element()->clearDelete();
                for (const QString &user : qAsConst(task->names))
                    task->element()->append(newUser(user));
            };
            task = list;
        } else if (type == DeleteOperation) {
            task = make<DeleteTask>("remove " + name, [name](auto *, FakeSystem *system) {
                return !system->failWrites && system->users.remove(name) == 1;
            }, element);
        } else {
            delete data;
            return;
        }
        TaskObserver::instance()->performTask(task);
    }

    static Element *newUser(const QString &name) { return new Ordinary(*current, rightsYes, QStringLiteral("user"), name); }

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
    static UsersModule *current;
};

UsersModule *UsersModule::current = nullptr;

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
    void create_data();
    void create();
    void deleteElement_data();
    void deleteElement();
    void printThroughStylesheet_data();
    void printThroughStylesheet();
    void dummyTasks();

private:
    void settle() { QTRY_COMPARE_WITH_TIMEOUT(TaskObserver::instance()->runningCount(), 0, 15000); }

    Workers workers;
    FakeSystem system;
    QStringList outcomes;
    ElementRootTreeNode *root = nullptr;
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
    UsersModule::current = module.get();
    root = new ElementRootTreeNode(module.get());
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
    // Tree nodes do not own their children.
    root->clearDeleteAll();
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
    QCOMPARE(system.users.value(QStringLiteral("alice")), writeFails ? QStringLiteral("likes tea") : QStringLiteral("drinks coffee"));
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
