// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/changedisplayelementdata.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/supplementelement.h>

#include "dialoganswerer.h"
#include "editwidget.h"
#include "recordingmodule.h"

#include <QShowEvent>
#include <QtTest>
#include <qtestspontaneevent.h>

#include <memory>

using Ordinary = TestElement<OrdinaryElement>;

namespace {

// A supplement (not selectable) that offers the change of display and
// records the display type it is asked for.
class SwitchingSupplement : public TestElement<SupplementElement>
{
public:
    explicit SwitchingSupplement(Module &module)
        : TestElement<SupplementElement>(module, rightsYes, QStringLiteral("extra"), QStringLiteral("x"))
    {
    }
    quint64 availableOperations() const override { return ChangeDisplayOperation; }
    void performOperation(OperationType, ElementData *data, int) override
    {
        if (auto *display = dynamic_cast<ChangeDisplayElementData *>(data))
            requested.append(display->displayType());
    }
    QList<int> requested;
};

} // namespace

class ElementWidgetTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<RecordingModule> module;
    ElementRootTreeNode *root = nullptr;
    Ordinary *alice = nullptr;
    Ordinary *bob = nullptr;

    EditWidget *newEditor()
    {
        auto *widget = new EditWidget(*module, rightsYes);
        module->insertElementWidget(widget);
        return widget;
    }

private Q_SLOTS:
    void init()
    {
        module.reset(new RecordingModule(QStringLiteral("users")));
        root = new ElementRootTreeNode(module.get());
        alice = new Ordinary(*module, rightsYes, QStringLiteral("user"), QStringLiteral("alice"));
        bob = new Ordinary(*module, rightsYes, QStringLiteral("user"), QStringLiteral("bob"));
        root->append(QList<TreeNode *>{alice, bob});
        module->log.clear();
    }
    void cleanup()
    {
        // Tree nodes do not own their children.
        root->clearDeleteAll();
        module.reset();
    }

    void editing_data()
    {
        // After some text typed, e, c: shows alice to edit, to create; t:<text> types,
        // i:<text> imports, u sets unchanged.
        QTest::addColumn<QString>("steps");
        QTest::addColumn<QList<int>>("reported");
        QTest::addColumn<bool>("changed");
        QTest::addColumn<bool>("enabled");

        // Editing waits for a read; creating starts at once, invalid but unchanged.
        QTest::newRow("edit") << "e" << QList<int>{} << false << false;
        QTest::newRow("create twice resets once") << "c c" << QList<int>{2} << false << true;
        QTest::newRow("edit then unchanged") << "e t:x u" << QList<int>{3, 0} << false << false;
        QTest::newRow("import counts as change") << "e i:y" << QList<int>{3} << true << false;
        QTest::newRow("create: unchanged reports anyway") << "c u u" << QList<int>{2, 0, 0} << false << true;
    }
    void editing()
    {
        QFETCH(QString, steps);

        EditWidget *editor = newEditor();
        editor->userTypes(QStringLiteral("before"));
        editor->reported.clear();
        ElementData imported;
        for (const QString &step : steps.split(QLatin1Char(' '))) {
            if (step == QLatin1String("e") || step == QLatin1String("c"))
                editor->setElement(alice, step == QLatin1String("e") ? EditElementRole : CreateElementRole);
            else if (step == QLatin1String("u"))
                editor->setUnchanged();
            else if (step.startsWith(QLatin1Char('t')))
                editor->userTypes(step.mid(2));
            else {
                imported.insert(QStringLiteral("text"), step.mid(2));
                editor->afterSuccessfulImport(&imported);
            }
        }
        QTEST(editor->reported, "reported");
        QTEST(editor->isChanged(), "changed");
        QTEST(editor->isEnabled(), "enabled");
    }

    void noReadWhenTheWindowSystemShows()
    {
        EditWidget *editor = newEditor();
        editor->setElement(alice, EditElementRole);
        QShowEvent restored;
        QSpontaneKeyEvent::setSpontaneous(&restored);
        // Delivered as the window system does: sendEvent() would clear the flag.
        qApp->notify(editor, &restored);
        QCOMPARE(module->log, QStringList{});
        // Only a show by the program reads the element.
        editor->show();
        QCOMPARE(module->log, QStringList{"ReadProperty(user_alice)"});
    }

    void setTreeNodeCurrent_data()
    {
        QTest::addColumn<QString>("target");
        QTest::addColumn<int>("answer"); // to the question about unsaved text; none: nothing typed
        QTest::addColumn<int>("madeCurrent");

        const int none = QMessageBox::NoButton;
        QTest::newRow("element") << "bob" << none << 1;
        QTest::newRow("supplement, no display change") << "supplement" << none << 0;
        QTest::newRow("supplement, display change") << "switching" << none << 1;
        QTest::newRow("changed, answer no") << "bob" << int(QMessageBox::No) << 0;
        QTest::newRow("changed, answer yes") << "bob" << int(QMessageBox::Yes) << 1;
    }
    void setTreeNodeCurrent()
    {
        QFETCH(QString, target);
        QFETCH(int, answer);

        auto *plain = new TestElement<SupplementElement>(*module, rightsYes, QStringLiteral("extra"));
        auto *switching = new SwitchingSupplement(*module);
        alice->append(QList<TreeNode *>{plain, switching});
        const QMap<QString, TreeNode *> targets{{"bob", bob}, {"supplement", plain}, {"switching", switching}};

        EditWidget *editor = newEditor();
        editor->setElement(alice, EditElementRole);
        if (answer != QMessageBox::NoButton)
            editor->userTypes(QStringLiteral("unsaved"));
        QSignalSpy current(targets.value(target), SIGNAL(setCurrentNode(TreeNode *)));
        DialogAnswerer answerer;
        answerer.answer(QMessageBox::StandardButton(answer));
        editor->setTreeNodeCurrent(targets.value(target));

        QTEST(int(current.count()), "madeCurrent");
        QCOMPARE(switching->requested, target == QLatin1String("switching") ? QList<int>{0} : QList<int>{});
        // Going on keeps the edit flagged: it has still not been saved.
        QCOMPARE(editor->isChanged(), answer != QMessageBox::NoButton);
        // Asked only about unsaved changes; the answer above needs its Yes button.
        QCOMPARE(answerer.seen.size(), answer != QMessageBox::NoButton ? 1 : 0);
    }
};

QTEST_MAIN(ElementWidgetTest)
#include "tst_elementwidget.moc"
