// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    void submit(std::function<bool(UserTask<Base> *)> work, std::function<void(UserTask<Base> *)> after, Args &&...args)
    {
        auto *task = new Probe<UserTask<Base>>(outcomes, std::forward<Args>(args)...);
        task->work = std::move(work);
        task->after = std::move(after);
        TaskObserver::instance()->performTask(task);
    }

    void performOperation(ContextOperation *context, OperationType type, ElementData *data, int flags) override
    {
        RecordingModule::performOperation(context, type, data, flags);
        Element *element = context ? context->elementContext() : nullptr;
        const QString name = element ? element->title() : QString();
        if (type == ReadPropertyOperation) {
            submit<ReadPropertyHeavyTask>([this, name](auto *t) {
                t->data() = new ElementData;
                t->data()->insert(QStringLiteral("text"), users.value(name));
                return true;
            }, nullptr, element);
        } else if (type == UpdateOperation) {
            submit<UpdateTask>([this, name](auto *t) {
                const QString text = t->data()->value(QStringLiteral("text")).toString();
                return !failWrites && users.insert(name, text) != users.end();
            }, nullptr, element, data);
        } else if (type == CreateOperation) {
            // Without force reread a plugin lists the new element itself.
            const bool lists = !getData(QStringLiteral("paranoid")).toBool();
            submit<CreateTask>([this](auto *t) { return users.insert(t->data()->name(), QString()) != users.end(); },
                               [this, lists](auto *t) {
                                   if (lists)
                                       t->element()->append(newUser(t->data()->name()));
                               }, container, data);
        } else if (type == ReadContentOperation) {
            // The record holds the name of a created element, if any.
            submit<ReadContentTask>([data](auto *t) {
                t->data() = data;
                return true;
            }, [this](auto *t) {
                t->element()->clearDelete();
                for (const QString &user : users.keys())
                    t->element()->append(newUser(user));
            }, element);
        } else if (type == DeleteOperation) {
            submit<DeleteTask>([this, name](auto *) { return users.remove(name) == 1; }, nullptr, element);
        } else {
            delete data;
        }
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
        root->append(module->container = users);
        users->append(alice = new Ordinary(*module, rightsYes, QStringLiteral("user"), QStringLiteral("alice")));
        module->insertElementWidget(editor = new EditWidget(*module, rightsYes, QStringLiteral("user")));
        module->insertElementWidget(creator = new EditWidget(*module, rightsYes, QStringLiteral("users")));
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
        // "<module's operations but insertions, then the widget's hooks> | <states the widget reported> |
        // <the container's elements> | <the widget's text> | <node made current> | <task outcomes>"
        QTest::addColumn<QString>("expected");

        const QString read = QStringLiteral("ReadProperty(user_alice) Update(user_alice) ");
        const QString reread = read + "ReadProperty(user_alice) read(user_alice) read(user_alice)";
        // Without a stored "false" the update is checked by reading back.
        QTest::newRow("edit, no force reread value") << "edit" << "absent" << false << reread
            + " | 3 0 | user_alice | drinks coffee |  | success success success";
        QTest::newRow("edit, trusting") << "edit" << "false" << false << read
            + "read(user_alice) update | 3 0 | user_alice | drinks coffee |  | success success";
        // A failed update is read back too, which shows the system's state.
        QTest::newRow("edit, force reread, failed") << "edit" << "true" << true << reread
            + " | 3 0 | user_alice | likes tea |  | success fail success";
        QTest::newRow("edit, trusting, failed keeps the change") << "edit" << "false" << true << read
            + "read(user_alice) | 3 | user_alice | drinks coffee |  | success fail";
        // The plugin lists the new element, and the creation widget is left unchanged.
        QTest::newRow("create, trusting") << "create" << "false" << false
            << "Create(widget) | 2 3 0 | user_alice user_carol | carol |  | success";
        // The container is read again, its elements replaced, and the new one selected by name.
        QTest::newRow("create, force reread") << "create" << "true" << false
            << "Create(widget) ReadContent(users_users) Removed(user_alice) | 2 3 | user_alice user_carol | carol | "
               "user_carol | success success";
        QTest::newRow("delete, trusting") << "delete" << "false" << false
            << "Delete(user_alice) Removed(user_alice) |  |  |  | users_users | success";
        // The element stays until its container is read again.
        QTest::newRow("delete, force reread") << "delete" << "true" << false
            << "Delete(user_alice) |  | user_alice |  | users_users | success";
    }
    void roundTrips()
    {
        QFETCH(QString, action);
        QFETCH(QString, forceReread);
        QFETCH(bool, fails);

        if (forceReread != QLatin1String("absent"))
            module->moduleDataRef()->insert(QStringLiteral("paranoid"), forceReread == QLatin1String("true"));
        QSignalSpy current(users, SIGNAL(setCurrentNode(TreeNode *)));
        EditWidget *widget = action == QLatin1String("create") ? creator : editor;
        if (action == QLatin1String("edit")) {
            editor->setElement(alice, EditElementRole);
            editor->show();
            settle();
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

        QStringList reported, madeCurrent;
        for (int state : widget->reported)
            reported.append(QString::number(state));
        for (const QList<QVariant> &signal : current)
            madeCurrent.append(signal.first().value<TreeNode *>()->id());
        const QStringList operations = module->log.filter(QRegularExpression(QStringLiteral("^(?!Inserted)")));
        const QStringList actual{(operations + widget->hooks).join(' '), reported.join(' '),
                                 TreeString::fromTree(users), widget->edit->text(), madeCurrent.join(' '),
                                 outcomes.join(' ')};
        QTEST(actual.join(QLatin1String(" | ")), "expected");
    }

    // The element goes while its update task runs (a reload, an unloaded
    // plugin): the task's afterRun() finds no element instead of freed memory.
    void taskOutlivesItsElement()
    {
        QSemaphore started, release;
        bool sawNull = false;
        auto *task = new Probe<UserTask<UpdateTask>>(&outcomes, alice, new ElementData);
        task->work = [&](auto *) {
            started.release();
            return release.tryAcquire(1, 10000);
        };
        task->after = [&](auto *t) { sawNull = t->element() == nullptr; };
        TaskObserver::instance()->performTask(task);
        QVERIFY(started.tryAcquire(1, 10000));
        users->removeOne(alice);
        delete alice;
        alice = nullptr;
        release.release();
        settle();
        QCOMPARE(outcomes, QStringList{QStringLiteral("success")});
        QVERIFY(sawNull);
    }

    void printThroughStylesheet()
    {
        const QString xml = QStringLiteral("<users><user>alice</user><user>b&amp;b</user></users>");
        QTemporaryDir dir;
        QVERIFY(writeFile(dir.filePath(QStringLiteral("report.xsl")), reportSheet));
        DialogAnswerer answerer;
        QString previewed;
        answerer.inspect = [&previewed](QDialog *dialog) {
            previewed = dialog->findChild<QTextEdit *>(QStringLiteral("_previewTextEdit"))->toPlainText();
        };
        // Shown in the preview when transformed; a missing stylesheet fails the task, with no preview.
        for (const QString stylesheet : {"report.xsl", "missing.xsl"}) {
            auto *data = new ElementData;
            data->insert(QStringLiteral("xmlText"), xml);
            data->insert(QStringLiteral("templateName"), QUrl::fromLocalFile(dir.filePath(stylesheet)).toString());
            TaskObserver::instance()->performTask(new Probe<PrintWidgetTask>(&outcomes, editor, data));
            settle();
        }
        QCOMPARE(outcomes, QStringList({"success", "fail: Internal error: XML transformation failed"}));
        QCOMPARE(answerer.seen, QStringList{"dialog:PreviewDialog"});
        QCOMPARE(previewed.trimmed(), QStringLiteral("alice;b&b;"));
    }
};

QTEST_MAIN(ElementTasksTest)
#include "tst_elementtasks.moc"
