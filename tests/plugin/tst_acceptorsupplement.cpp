#include <kvt-common/acceptormodule.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/moduleroottreenode.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/supplementmodule.h>

#include "recordingmodule.h"

#include <QSettings>
#include <QtTest>

#include <memory>

namespace {

// The context of an element widget: operations a widget performs reach its
// module with this kind of context.
class WidgetContext : public ContextOperation
{
public:
    explicit WidgetContext(Module &module)
        : ContextOperation(ElementWidgetContextType, module, rightsYes)
    {
    }
    QString toolTipText() const override { return QString(); }
};

using User = TestElement<OrdinaryElement>;

std::unique_ptr<Module> makeModule(const QString &kind, const QString &name, Module *donor = nullptr)
{
    if (kind == QLatin1String("acceptor"))
        return std::make_unique<AcceptorModule>(name, 2, QStringLiteral("users"),
                                                QStringLiteral("Quotas of users"));
    return std::make_unique<SupplementModule>(name, 2, QStringLiteral("users"),
                                              QStringLiteral("Quotas of users"),
                                              QStringLiteral("user"), donor);
}

} // namespace

class AcceptorSupplementTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void noForceReread_data();
    void noForceReread();
    void elementFromDonor_data();
    void elementFromDonor();
    void supplementPassesInsertions_data();
    void supplementPassesInsertions();
};

void AcceptorSupplementTest::noForceReread_data()
{
    QTest::addColumn<QString>("kind");
    QTest::newRow("acceptor") << "acceptor";
    QTest::newRow("supplement") << "supplement";
}

void AcceptorSupplementTest::noForceReread()
{
    QFETCH(QString, kind);
    const QString key = QStringLiteral("module/quotasparanoid");
    QSettings().setValue(key, QStringLiteral("stored by someone else"));

    {
        RecordingModule donor(QStringLiteral("users"));
        std::unique_ptr<Module> module = makeModule(kind, QStringLiteral("quotas"), &donor);

        QCOMPARE(module->expectedDepth(), 2);
        QCOMPARE(module->expectedParentId(), QStringLiteral("users"));
        QVERIFY(!module->moduleData()->contains(QStringLiteral("paranoid")));
        QCOMPARE(module->getData(QStringLiteral("description")).toString(),
                 QStringLiteral("Quotas of users"));
        // The "Reread" column is empty and cannot be ticked.
        QVERIFY(!module->data(1, Qt::CheckStateRole).isValid());
        QVERIFY(!(module->flags(1) & Qt::ItemIsUserCheckable));
        QVERIFY(!module->setData(1, Qt::Checked, Qt::CheckStateRole));
        QCOMPARE(module->data(2, Qt::DisplayRole).toString(), QStringLiteral("Quotas of users"));
    }
    // Nothing saved when the module goes.
    QCOMPARE(QSettings().value(key).toString(), QStringLiteral("stored by someone else"));
    QSettings().remove(key);
}

void AcceptorSupplementTest::elementFromDonor_data()
{
    QTest::addColumn<QString>("placement");
    QTest::addColumn<QString>("name");
    QTest::addColumn<QString>("expected");

    QTest::newRow("below the donor") << "donor" << "user_alice" << "user_alice";
    QTest::newRow("not in the donor") << "donor" << "user_carol" << "";
    QTest::newRow("a node of the donor that is no element") << "donor" << "plain" << "";
    QTest::newRow("below the module root") << "root" << "user_alice" << "";
    QTest::newRow("detached") << "none" << "user_alice" << "";
}

void AcceptorSupplementTest::elementFromDonor()
{
    QFETCH(QString, placement);
    QFETCH(QString, name);
    QFETCH(QString, expected);

    ModuleRootTreeNode root;
    RecordingModule donor(QStringLiteral("users"));
    User alice(donor, rightsYes, QStringLiteral("user"), QStringLiteral("alice"));
    User bob(donor, rightsYes, QStringLiteral("user"), QStringLiteral("bob"));
    TreeNode plain;
    plain.setId(QStringLiteral("plain"));
    donor.elementNodesRef() << &alice << &plain << &bob;
    root.append(&donor);
    AcceptorModule acceptor(QStringLiteral("quotas"), 2, QStringLiteral("users"), QString());
    if (placement == QLatin1String("donor"))
        donor.append(&acceptor);
    else if (placement == QLatin1String("root"))
        root.append(&acceptor);

    Element *element = acceptor.elementFromDonor(name);

    QCOMPARE(element ? element->id() : QString(), expected);
    root.clear();
    donor.clear();
}

void AcceptorSupplementTest::supplementPassesInsertions_data()
{
    QTest::addColumn<QString>("context");
    QTest::addColumn<int>("operation");
    QTest::addColumn<QStringList>("donorLog");

    QTest::newRow("insertion of a user") << "user" << int(InsertedOperation)
                                         << QStringList{"Inserted(user_alice) flags=7"};
    QTest::newRow("insertion of a group") << "group" << int(InsertedOperation) << QStringList();
    QTest::newRow("removal of a user") << "user" << int(RemovedOperation) << QStringList();
    QTest::newRow("update of a user") << "user" << int(UpdateOperation) << QStringList();
    QTest::newRow("insertion by a widget") << "widget" << int(InsertedOperation) << QStringList();
    QTest::newRow("no context") << "null" << int(InsertedOperation) << QStringList();
}

void AcceptorSupplementTest::supplementPassesInsertions()
{
    QFETCH(QString, context);
    QFETCH(int, operation);
    QFETCH(QStringList, donorLog);

    RecordingModule donor(QStringLiteral("users"));
    SupplementModule supplement(QStringLiteral("mail"), 2, QStringLiteral("users"), QString(),
                                QStringLiteral("user"), &donor);
    // A module below the supplement hears nothing: operations stop there.
    RecordingModule below(QStringLiteral("below"));
    supplement.append(&below);
    QCOMPARE(supplement.donorModule(), &donor);
    QCOMPARE(supplement.supplementElementType(), QStringLiteral("user"));

    User user(supplement, rightsYes, QStringLiteral("user"), QStringLiteral("alice"));
    User group(supplement, rightsYes, QStringLiteral("group"), QStringLiteral("staff"));
    WidgetContext widget(supplement);
    ContextOperation *contexts[] = {&user, &group, &widget, nullptr};
    const QStringList names{"user", "group", "widget", "null"};
    ElementData data;

    supplement.performOperation(contexts[names.indexOf(context)], OperationType(operation), &data, 7);

    QCOMPARE(donor.log, donorLog);
    // The record is passed on as it is.
    if (!donorLog.isEmpty())
        QCOMPARE(donor.dataLog.value(0), &data);
    QVERIFY(below.log.isEmpty());
    supplement.clear();
}

QTEST_MAIN(AcceptorSupplementTest)
#include "tst_acceptorsupplement.moc"
