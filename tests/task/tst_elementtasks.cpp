#include <kvt-common/containerelement.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/previewdialog.h>
#include <kvt-common/printwidgettask.h>
#include <kvt-common/readpropertyheavytask.h>
#include <kvt-common/taskobserverdialog.h>
#include <kvt-common/updatetask.h>

#include "../system/systemtest.h"
#include "../widget/editwidget.h"
#include "dialoganswerer.h"
#include "recordingmodule.h"
#include "taskprobe.h"

#include <QTextEdit>
#include <QtTest>

#include <memory>

using Container = TestElement<ContainerElement>;
using Ordinary = TestElement<OrdinaryElement>;

namespace {

// A plugin's task: run() does its work on the task's record, which fails the
// task when it returns false.
template <class Base>
class UserTask : public Base
{
public:
    template <class... Args>
    UserTask(std::function<bool(ElementData *&)> work, Args... args) : Base(args...), work(std::move(work))
    {
    }
    void run() override
    {
        this->taskDescription().setStatus(work(this->_elementData) ? TaskDescription::Success : TaskDescription::Fail);
        AbstractTask::run();
    }
    std::function<bool(ElementData *&)> work;
};

// A plugin's module administering user names with a text each: reading and
// updating an element are tasks.
class UsersModule : public RecordingModule
{
public:
    explicit UsersModule(QStringList *outcomes) : RecordingModule(QStringLiteral("users")), outcomes(outcomes) {}

    void performOperation(ContextOperation *context, OperationType type, ElementData *data, int flags) override
    {
        RecordingModule::performOperation(context, type, data, flags);
        Element *element = context ? context->elementContext() : nullptr;
        const QString name = element ? element->title() : QString();
        const QLatin1String text("text");
        if (type == ReadPropertyOperation) {
            TaskObserver::instance()->performTask(new Probe<UserTask<ReadPropertyHeavyTask>>(outcomes, [=](ElementData *&read) {
                (read = new ElementData)->insert(text, users.value(name));
                return true;
            }, element));
        } else if (type == UpdateOperation) {
            TaskObserver::instance()->performTask(new Probe<UserTask<UpdateTask>>(outcomes, [=](ElementData *&written) {
                return !failWrites && users.insert(name, written->value(text).toString()) != users.end();
            }, element, data));
        } else {
            delete data;
        }
    }

    QStringList *outcomes;
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
    EditWidget *editor = nullptr;

    void settle() { QTRY_COMPARE_WITH_TIMEOUT(TaskObserver::instance()->runningCount(), 0, 15000); }

private Q_SLOTS:
    void initTestCase() { workers.start(3); }
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
        root->append(users = new Container(*module, rightsYes, QStringLiteral("users"), QStringLiteral("users")));
        users->append(alice = new Ordinary(*module, rightsYes, QStringLiteral("user"), QStringLiteral("alice")));
        module->insertElementWidget(editor = new EditWidget(*module, rightsYes, QStringLiteral("user")));
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
        QTest::addColumn<QString>("forceReread");
        QTest::addColumn<bool>("fails");
        // "<module's operations but insertions, then the widget's hooks> | <states the widget reported> |
        // <the widget's text> | <task outcomes>"
        QTest::addColumn<QString>("expected");

        const QString read = QStringLiteral("ReadProperty(user_alice) Update(user_alice) ");
        const QString reread = read + "ReadProperty(user_alice) read(user_alice) read(user_alice)";
        // Without a stored "false" the update is checked by reading back.
        QTest::newRow("no force reread value") << "absent" << false << reread
            + " | 3 0 | drinks coffee | success success success";
        QTest::newRow("trusting") << "false" << false << read
            + "read(user_alice) update | 3 0 | drinks coffee | success success";
        // A failed update is read back too, which shows the system's state.
        QTest::newRow("force reread, failed") << "true" << true << reread
            + " | 3 0 | likes tea | success fail success";
        QTest::newRow("trusting, failed keeps the change") << "false" << true << read
            + "read(user_alice) | 3 | drinks coffee | success fail";
    }
    void roundTrips()
    {
        QFETCH(QString, forceReread);
        QFETCH(bool, fails);

        if (forceReread != QLatin1String("absent"))
            module->moduleDataRef()->insert(QStringLiteral("paranoid"), forceReread == QLatin1String("true"));
        module->failWrites = fails;
        editor->setElement(alice, EditElementRole);
        editor->show();
        settle();
        editor->userTypes(QStringLiteral("drinks coffee"));
        editor->applyContentChanges();
        settle();

        QStringList reported;
        for (int state : editor->reported)
            reported.append(QString::number(state));
        const QStringList operations = module->log.filter(QRegularExpression(QStringLiteral("^(?!Inserted)")));
        const QStringList actual{(operations + editor->hooks).join(' '), reported.join(' '),
                                 editor->edit->text(),
                                 outcomes.join(' ')};
        QTEST(actual.join(QLatin1String(" | ")), "expected");
    }

    void printThroughStylesheet()
    {
        QTemporaryDir dir;
        QVERIFY(writeFile(dir.filePath(QStringLiteral("report.xsl")), reportSheet));
        DialogAnswerer answerer;
        QString previewed;
        answerer.inspect = [&](QDialog *d) { previewed = d->findChild<QTextEdit *>("_previewTextEdit")->toPlainText(); };
        // Shown in the preview when transformed; a missing stylesheet fails the task, with no preview.
        for (const QString stylesheet : {"report.xsl", "missing.xsl"}) {
            auto *data = new ElementData;
            data->insert(QStringLiteral("xmlText"), QStringLiteral("<users><user>alice</user><user>b&amp;b</user></users>"));
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
