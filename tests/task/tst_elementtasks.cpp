#include <kvt-common/containerelement.h>
#include <kvt-common/createtask.h>
#include <kvt-common/deletetask.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/previewdialog.h>
#include <kvt-common/printwidgettask.h>
#include <kvt-common/readcontenttask.h>
#include <kvt-common/readpropertyheavytask.h>
#include <kvt-common/taskobserverdialog.h>
#include <kvt-common/updatetask.h>

#include "../system/systemtest.h"
#include "../widget/editwidget.h"
#include "dialoganswerer.h"
#include "recordingmodule.h"
#include "taskprobe.h"
#include "treestring.h"

#include <QTextEdit>
#include <QtTest>

#include <memory>

using Container = TestElement<ContainerElement>;
using Ordinary = TestElement<OrdinaryElement>;

namespace {

// A plugin's task: run() does its work, which fails the task when it returns
// false; on success afterRun() first runs \a after, as a plugin's override
// would, then the library's.
template <class Base>
class UserTask : public Base
{
public:
    using Base::Base;
    void run() override
    {
        this->taskDescription().setStatus(work(this) ? TaskDescription::Success : TaskDescription::Fail);
        AbstractTask::run();
    }
    void afterRun() override
    {
        if (after && this->taskDescription().status() == TaskDescription::Success)
            after(this);
        Base::afterRun();
    }
    ElementData *&data() { return this->_elementData; }

    std::function<bool(UserTask *)> work;
    std::function<void(UserTask *)> after;
};

// A plugin's module administering user names with a text each: every
// operation becomes a task. A widget's creation goes under the container.
class UsersModule : public RecordingModule
{
public:
    explicit UsersModule(QStringList *outcomes) : RecordingModule(QStringLiteral("users")), outcomes(outcomes) {}

    template <class Base, class... Args>
    UserTask<Base> *submit(std::function<bool(UserTask<Base> *)> work, Args &&...args)
    {
        auto *task = new Probe<UserTask<Base>>(outcomes, std::forward<Args>(args)...);
        task->work = std::move(work);
        return task;
    }

    void performOperation(ContextOperation *context, OperationType type, ElementData *data, int flags) override
    {
        RecordingModule::performOperation(context, type, data, flags);
        Element *element = context ? context->elementContext() : nullptr;
        const QString name = element ? element->title() : QString();
        AbstractTask *task = nullptr;
        if (type == ReadPropertyOperation) {
            task = submit<ReadPropertyHeavyTask>([this, name](auto *t) {
                t->data() = new ElementData;
                t->data()->insert(QStringLiteral("text"), users.value(name));
                return true;
            }, element);
        } else if (type == UpdateOperation) {
            task = submit<UpdateTask>([this, name](auto *t) {
                if (!failWrites)
                    users.insert(name, t->data()->value(QStringLiteral("text")).toString());
                return !failWrites;
            }, element, data);
        } else if (type == CreateOperation) {
            auto *create = submit<CreateTask>([this](auto *t) {
                if (!failWrites)
                    users.insert(t->data()->name(), QString());
                return !failWrites;
            }, container, data);
            // Without force reread a plugin lists the new element itself.
            if (!getData(QStringLiteral("paranoid")).toBool())
                create->after = [this](auto *t) { t->element()->append(newUser(t->data()->name())); };
            task = create;
        } else if (type == ReadContentOperation) {
            auto *list = submit<ReadContentTask>([](auto *) { return true; }, element);
            list->data() = data; // the name of a created element, if any
            list->after = [this](auto *t) {
                t->element()->clearDelete();
                for (const QString &user : users.keys())
                    t->element()->append(newUser(user));
            };
            task = list;
        } else if (type == DeleteOperation) {
            task = submit<DeleteTask>([this, name](auto *) { return !failWrites && users.remove(name) == 1; }, element);
        }
        if (task)
            TaskObserver::instance()->performTask(task);
        else
            delete data;
    }

    Element *newUser(const QString &name) { return new Ordinary(*this, rightsYes, QStringLiteral("user"), name); }

    QStringList *outcomes;
    Element *container = nullptr;
    // The administered system, changed by tasks while the test waits.
    QMap<QString, QString> users{{QStringLiteral("alice"), QStringLiteral("likes tea")}};
    bool failWrites = false;
};

const char reportSheet[] = "<xsl:stylesheet version='2.0' xmlns:xsl='http://www.w3.org/1999/XSL/Transform'>"
                           "<xsl:template match='/'><html><body><p><xsl:for-each select='users/user'>"
                           "<xsl:value-of select='.'/>;</xsl:for-each></p></body></html></xsl:template>"
                           "</xsl:stylesheet>";

} // namespace

class ElementTasksTest : public QObject
{
    Q_OBJECT

    Workers workers;
    QStringList outcomes;
    ElementRootTreeNode *root = nullptr;
    std::unique_ptr<UsersModule> module;
    Container *users = nullptr;
    Ordinary *alice = nullptr;
    EditWidget *editor = nullptr;  // edits users
    EditWidget *creator = nullptr; // creates users: the widget of the container's type

    void settle() { QTRY_COMPARE_WITH_TIMEOUT(TaskObserver::instance()->runningCount(), 0, 15000); }

private Q_SLOTS:
    void initTestCase()
    {
        qRegisterMetaType<TreeNode *>();
        workers.start(3);
    }
    void cleanupTestCase()
    {
        workers.stop();
        delete PreviewDialog::instance();
        delete TaskObserver::instance();
    }
    void init()
    {
        module.reset(new UsersModule(&outcomes));
        module->moduleDataRef()->remove(QStringLiteral("paranoid")); // what an earlier run stored
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
    void cleanup()
    {
        settle();
        // Tree nodes do not own their children.
        root->clearDeleteAll();
        module.reset();
        outcomes.clear();
        TaskObserver::instance()->dialog()->hide();
    }

    void roundTrips_data()
    {
        QTest::addColumn<QString>("action"); // edit alice's text, create carol, delete alice
        QTest::addColumn<QString>("forceReread");
        QTest::addColumn<bool>("fails");
        QTest::addColumn<QString>("trace"); // the module's operations but insertions, then the widget's hooks
        QTest::addColumn<QList<int>>("reported");
        QTest::addColumn<QString>("shown"); // the container's elements | the widget's text
        QTest::addColumn<QString>("madeCurrent");
        QTest::addColumn<QString>("taskOutcomes");

        const QString read = QStringLiteral("ReadProperty(user_alice) Update(user_alice) ");
        const QString reread = read + "ReadProperty(user_alice) read(user_alice) read(user_alice)";
        // Without a stored "false" the update is checked by reading back.
        QTest::newRow("edit, no force reread value") << "edit" << "absent" << false << reread << QList<int>{3, 0}
                                                     << "user_alice | drinks coffee" << "" << "success success success";
        QTest::newRow("edit, trusting") << "edit" << "false" << false << read + "read(user_alice) update"
                                        << QList<int>{3, 0} << "user_alice | drinks coffee" << "" << "success success";
        // A failed update is read back too, which shows the system's state.
        QTest::newRow("edit, force reread, failed") << "edit" << "true" << true << reread << QList<int>{3, 0}
                                                    << "user_alice | likes tea" << "" << "success fail success";
        QTest::newRow("edit, trusting, failed keeps the change")
            << "edit" << "false" << true << read + "read(user_alice)" << QList<int>{3} << "user_alice | drinks coffee"
            << "" << "success fail";

        // Reading the container again, the plugin replaces the elements it lists.
        const QString relist = QStringLiteral("Create(widget) ReadContent(users_users) Removed(user_alice)");
        // The plugin lists the new element, and the creation widget is left unchanged.
        QTest::newRow("create, trusting") << "create" << "false" << false << "Create(widget)" << QList<int>{2, 3, 0}
                                          << "user_alice user_carol | carol" << "" << "success";
        // The container is read again and selects the new element by name.
        QTest::newRow("create, force reread") << "create" << "true" << false << relist << QList<int>{2, 3}
                                              << "user_alice user_carol | carol" << "user_carol" << "success success";
        QTest::newRow("create, trusting, failed") << "create" << "false" << true << "Create(widget)" << QList<int>{2, 3}
                                                  << "user_alice | carol" << "" << "fail";

        QTest::newRow("delete, trusting") << "delete" << "false" << false << "Delete(user_alice) Removed(user_alice)"
                                          << QList<int>{} << " | " << "users_users" << "success";
        // The element stays until its container is read again.
        QTest::newRow("delete, force reread") << "delete" << "true" << false << "Delete(user_alice)" << QList<int>{}
                                              << "user_alice | " << "users_users" << "success";
        QTest::newRow("delete, trusting, failed") << "delete" << "false" << true << "Delete(user_alice)"
                                                  << QList<int>{} << "user_alice | " << "" << "fail";
    }
    void roundTrips()
    {
        QFETCH(QString, action);
        QFETCH(QString, forceReread);
        QFETCH(bool, fails);
        QFETCH(QString, trace);
        QFETCH(QList<int>, reported);
        QFETCH(QString, shown);
        QFETCH(QString, madeCurrent);
        QFETCH(QString, taskOutcomes);

        if (forceReread != QLatin1String("absent"))
            module->moduleDataRef()->insert(QStringLiteral("paranoid"), forceReread == QLatin1String("true"));
        QSignalSpy current(users, SIGNAL(setCurrentNode(TreeNode *)));
        EditWidget *widget = action == QLatin1String("create") ? creator : editor;
        if (action == QLatin1String("edit")) {
            editor->setElement(alice, EditElementRole);
            editor->show();
            settle();
            QCOMPARE(editor->edit->text(), QStringLiteral("likes tea"));
            QVERIFY(editor->isEnabled());
            QVERIFY(!editor->isChanged());
            editor->userTypes(QStringLiteral("drinks coffee"));
        } else if (action == QLatin1String("create")) {
            // As the element widget container does for a creation.
            creator->setElement(nullptr, CreateElementRole);
            creator->userTypes(QStringLiteral("carol"));
        }
        module->failWrites = fails;
        if (action == QLatin1String("delete"))
            alice->performOperation(DeleteOperation, nullptr, 0);
        else
            widget->applyContentChanges();
        settle();

        const QStringList operations = module->log.filter(QRegularExpression(QStringLiteral("^(?!Inserted)")));
        QCOMPARE((operations + widget->hooks).join(QLatin1Char(' ')), trace);
        QCOMPARE(widget->reported, reported);
        QCOMPARE(widget->isChanged(), !reported.isEmpty() && reported.last() != 0);
        QCOMPARE(TreeString::fromTree(users) + " | " + widget->edit->text(), shown);
        QCOMPARE(current.count(), madeCurrent.isEmpty() ? 0 : 1);
        if (!current.isEmpty())
            QCOMPARE(current.first().first().value<TreeNode *>()->id(), madeCurrent);
        QCOMPARE(outcomes.join(QLatin1Char(' ')), taskOutcomes);
    }

    void printThroughStylesheet_data()
    {
        QTest::addColumn<QString>("stylesheet");
        QTest::addColumn<QString>("xml");
        QTest::addColumn<QString>("outcome");
        QTest::addColumn<QString>("shown");

        const QString xml = QStringLiteral("<users><user>alice</user><user>b&amp;b</user></users>");
        const QString failure = QStringLiteral("fail: Internal error: XML transformation failed");
        QTest::newRow("transformed") << "report.xsl" << xml << "success" << "alice;b&b;";
        QTest::newRow("missing stylesheet") << "missing.xsl" << xml << failure << "";
        QTest::newRow("no stylesheet named") << "" << xml << failure << "";
        QTest::newRow("broken document") << "report.xsl" << "<users><user>" << failure << "";
    }
    void printThroughStylesheet()
    {
        QFETCH(QString, stylesheet);
        QFETCH(QString, xml);
        QFETCH(QString, outcome);
        QFETCH(QString, shown);

        QTemporaryDir dir;
        QVERIFY(writeFile(dir.filePath(QStringLiteral("report.xsl")), reportSheet));
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
};

QTEST_MAIN(ElementTasksTest)
#include "tst_elementtasks.moc"
