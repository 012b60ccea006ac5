// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// kvt-admin end to end: the main window with the build tree's plugins, in a
// real X server, driven by mouse and key events; what matters is what lands
// in the files.

#include "admintest.h"
#include "dialoganswerer.h"
#include "mainwindow.h"
#include "workerthreads.h"

#include <kvt-common/element.h>
#include <kvt-common/elementtreeview.h>
#include <kvt-common/elementwidgetcontainer2.h>
#include <kvt-common/plugincontainer.h>
#include <kvt-common/pluginmodel.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/taskobserverdialog.h>
#include <kvt-common/taskobservermodel.h>
#include <kvt-common/treenodemodel.h>
#include <kvt-common/vieweditelementwidget.h>

#include <QAbstractItemModelTester>
#include <QAction>
#include <QDir>
#include <QFile>
#include <QLabel>
#include <QLineEdit>
#include <QSettings>
#include <QTest>

#include <sys/stat.h>
#include <unistd.h>

using namespace AdminTest;

namespace {

const QByteArray sample = "# Sample settings\n"
                          "\n"
                          "NAME = value  # trailing words\n"
                          "indent\tvalue with spaces\n"
                          "  SPACED   =   far   #note\n"
                          "LAST = end";

struct FileIdentity
{
    ino_t inode = 0;
    mode_t mode = 0;
    uid_t owner = 0;
    bool operator==(const FileIdentity &o) const { return inode == o.inode && mode == o.mode && owner == o.owner; }
};

FileIdentity identity(const QString &path)
{
    struct stat st {};
    FileIdentity id;
    if (::stat(QFile::encodeName(path).constData(), &st) == 0) {
        id.inode = st.st_ino;
        id.mode = st.st_mode;
        id.owner = st.st_uid;
    }
    return id;
}

QLineEdit *edit(MainWindow &window, const char *name)
{
    return window.widgetContainer()->findChild<QLineEdit *>(QLatin1String(name));
}

// What the task list says, one "status|message" per row.
QStringList taskRows()
{
    QStringList rows;
    for (const TaskObserver::Row &row : TaskObserver::instance()->rows())
        rows << QStringLiteral("%1|%2").arg(int(row.description.status())).arg(row.description.message());
    return rows;
}

} // namespace

class TestKvtAdmin : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void init();
    void cleanup();
    void cleanupTestCase();

    void readShowsKeysAndValues();
    void applyWritesOneLine_data();
    void applyWritesOneLine();
    void createAndDeleteKey_data();
    void createAndDeleteKey();
    void leavingEditedKeyAsks_data();
    void leavingEditedKeyAsks();
    void failingTaskOpensTaskDialog_data();
    void failingTaskOpensTaskDialog();
    void linesThatCannotBeChanged();
    void pluginDialogListsRefusedFile();

private:
    // Opens the window on the sandbox files and chooses the module.
    void open(const QStringList &files);

    std::unique_ptr<WorkerThreads> _workers;
    std::unique_ptr<Sandbox> _sandbox;
    std::unique_ptr<MainWindow> _window;
    std::unique_ptr<DialogAnswerer> _answerer;
};

void TestKvtAdmin::initTestCase()
{
    QCoreApplication::setOrganizationName(QStringLiteral("kvt-admin"));
    QCoreApplication::setApplicationName(QStringLiteral("kvt-admin"));
    QVERIFY(QFile::exists(QStringLiteral(KVT_ADMIN_PLUGIN_DIR "/conffiles.so")));
    // Workers live as long as the process: they cannot be restarted.
    _workers = std::make_unique<WorkerThreads>(2);
}

void TestKvtAdmin::init()
{
    // Each test starts from no settings (force reread mode off).
    QSettings().clear();
    _sandbox = std::make_unique<Sandbox>();
    QVERIFY(_sandbox->isValid());
    _sandbox->write(QStringLiteral("sample.conf"), sample);
    _answerer = std::make_unique<DialogAnswerer>();
}

void TestKvtAdmin::cleanup()
{
    if (_window) {
        if (TaskObserverDialog *dialog = TaskObserver::instance()->dialog())
            dialog->reject();
        QVERIFY(waitIdle());
        _window.reset();
    }
    _answerer.reset();
    _sandbox.reset();
}

void TestKvtAdmin::cleanupTestCase()
{
    _workers.reset();
}

void TestKvtAdmin::open(const QStringList &files)
{
    _sandbox->manage(files);
    _window = openMainWindow();
    QAbstractItemModelTester elementTester(_window->elementView()->model(),
                                           QAbstractItemModelTester::FailureReportingMode::QtTest);
    QVERIFY(chooseModule(*_window, QStringLiteral("conffiles")));
}

void TestKvtAdmin::readShowsKeysAndValues()
{
    open({QStringLiteral("sample.conf")});
    QAbstractItemModelTester tester(_window->elementView()->model(),
                                    QAbstractItemModelTester::FailureReportingMode::QtTest);
    const QString file = _sandbox->path(QStringLiteral("sample.conf"));
    // Choosing the file reads it: its keys appear, in file order.
    Element *element = chooseElement(*_window, {file});
    QVERIFY(element);
    QAbstractItemModel *model = _window->elementView()->model();
    const QModelIndex fileIndex = model->index(0, 0);
    QStringList shown;
    for (int row = 0; row < model->rowCount(fileIndex); ++row)
        shown << model->index(row, 0, fileIndex).data().toString();
    QCOMPARE(shown, QStringList({"NAME = value", "indent = value with spaces", "SPACED = far", "LAST = end"}));

    // Choosing a key shows what is on disk, read by a task.
    QVERIFY(chooseElement(*_window, {file, QStringLiteral("SPACED")}));
    QCOMPARE(edit(*_window, "_valueLineEdit")->text(), QStringLiteral("far"));
    QCOMPARE(edit(*_window, "_commentLineEdit")->text(), QStringLiteral("note"));
    QVERIFY(edit(*_window, "_keyLineEdit")->isReadOnly());
    QVERIFY(!action(*_window, "applyAction")->isEnabled());
    screenshot(_window.get(), QStringLiteral("kvt-admin-key"));
}

void TestKvtAdmin::applyWritesOneLine_data()
{
    QTest::addColumn<QString>("file");
    QTest::addColumn<QByteArray>("before");
    QTest::addColumn<QString>("key");
    QTest::addColumn<QString>("value");
    QTest::addColumn<QString>("comment");
    QTest::addColumn<bool>("forceReread");
    QTest::addColumn<QByteArray>("after");

    QTest::newRow("comment and its spacing kept")
        << "sample.conf" << sample << "NAME" << "new value" << "trailing words" << false
        << QByteArray(sample).replace("NAME = value  #", "NAME = new value  #");
    QTest::newRow("blank separator and no comment")
        << "sample.conf" << sample << "indent" << "v2" << "" << false
        << QByteArray(sample).replace("indent\tvalue with spaces", "indent\tv2");
    QTest::newRow("comment changed, indentation kept")
        << "sample.conf" << sample << "SPACED" << "near" << "changed" << false
        << QByteArray(sample).replace("  SPACED   =   far   #note", "  SPACED   =   near   #changed");
    QTest::newRow("last line without line end")
        << "sample.conf" << sample << "LAST" << "fin" << "" << false
        << QByteArray(sample).replace("LAST = end", "LAST = fin");
    QTest::newRow("CRLF line ends")
        << "crlf.conf" << QByteArray("A = 1\r\n# c\r\nB = 2\r\n") << "B" << "3" << "" << false
        << QByteArray("A = 1\r\n# c\r\nB = 3\r\n");
    QTest::newRow("force reread mode")
        << "sample.conf" << sample << "NAME" << "reread" << "trailing words" << true
        << QByteArray(sample).replace("NAME = value  #", "NAME = reread  #");
}

void TestKvtAdmin::applyWritesOneLine()
{
    QFETCH(QString, file);
    QFETCH(QByteArray, before);
    QFETCH(QString, key);
    QFETCH(QString, value);
    QFETCH(QString, comment);
    QFETCH(bool, forceReread);
    QFETCH(QByteArray, after);

    const QString path = _sandbox->write(file, before);
    open({file});
    if (forceReread) {
        // The module's check box in the Reread column.
        auto *model = _window->pluginContainer()->treeNodeModel();
        const QModelIndex module = model->treeNodeToIndex(_window->currentModule());
        QVERIFY(model->setData(module.sibling(module.row(), 1), Qt::Checked, Qt::CheckStateRole));
    }
    const FileIdentity was = identity(path);
    QVERIFY(chooseElement(*_window, {path, key}));
    QLineEdit *valueEdit = edit(*_window, "_valueLineEdit");
    QVERIFY(valueEdit->isEnabled());
    typeInto(valueEdit, value);
    typeInto(edit(*_window, "_commentLineEdit"), comment);
    QVERIFY(trigger(*_window, "applyAction"));
    QVERIFY(waitIdle());

    QCOMPARE(readFile(path), after);
    QCOMPARE(readFile(path + QStringLiteral(".bak")), before);
    QVERIFY(!QFile::exists(path + QStringLiteral(".tmp")));
    QVERIFY(identity(path) == was);
    QCOMPARE(_window->currentElement()->data(0, Qt::DisplayRole).toString(),
             QStringLiteral("%1 = %2").arg(key, value));
    QVERIFY(!_window->shownEditWidget()->isChanged());
    QVERIFY(!action(*_window, "applyAction")->isEnabled());
    QCOMPARE(valueEdit->text(), value);
    QVERIFY(taskRows().isEmpty()); // all went well: the list was cleared
}

void TestKvtAdmin::createAndDeleteKey_data()
{
    QTest::addColumn<bool>("forceReread");
    // Trusting the task's result, or reading the file again after it.
    QTest::newRow("result trusted") << false;
    QTest::newRow("force reread mode") << true;
}

void TestKvtAdmin::createAndDeleteKey()
{
    QFETCH(bool, forceReread);
    QSettings().setValue(QStringLiteral("module/conffilesparanoid"), forceReread);
    open({QStringLiteral("sample.conf")});
    const QString path = _sandbox->path(QStringLiteral("sample.conf"));
    QVERIFY(chooseElement(*_window, {path}));

    QVERIFY(trigger(*_window, "createAction"));
    ViewEditElementWidget *widget = _window->shownEditWidget();
    QVERIFY(widget);
    QCOMPARE(int(widget->role()), int(CreateElementRole));
    QVERIFY(!action(*_window, "applyAction")->isEnabled());
    typeInto(edit(*_window, "_keyLineEdit"), QStringLiteral("NEW.KEY"));
    typeInto(edit(*_window, "_valueLineEdit"), QStringLiteral("42"));
    typeInto(edit(*_window, "_commentLineEdit"), QStringLiteral("added"));
    QVERIFY(trigger(*_window, "applyAction"));
    QVERIFY(waitIdle());
    // The last line gets its line end first; the new line follows the
    // file's usual separator.
    const QByteArray created = sample + "\nNEW.KEY = 42  # added\n";
    QCOMPARE(readFile(path), created);
    QVERIFY(_window->currentElement());
    QCOMPARE(_window->currentElement()->title(), QStringLiteral("NEW.KEY"));

    // A key that exists cannot be created twice: the task says so.
    QVERIFY(chooseElement(*_window, {path}));
    QVERIFY(trigger(*_window, "createAction"));
    typeInto(edit(*_window, "_keyLineEdit"), QStringLiteral("NAME"));
    typeInto(edit(*_window, "_valueLineEdit"), QStringLiteral("again"));
    QVERIFY(trigger(*_window, "applyAction"));
    QVERIFY(waitIdle());
    QCOMPARE(readFile(path), created);
    QVERIFY(taskRows().join(QLatin1Char('\n')).contains(QStringLiteral("already sets \"NAME\" (line 3)")));
    TaskObserver::instance()->dialog()->reject();
    _answerer->answer(QMessageBox::Discard); // leave the refused form
    QVERIFY(chooseElement(*_window, {path, QStringLiteral("NEW.KEY")}));

    // Delete asks first; No keeps the line, Yes removes it.
    _answerer->answer(QMessageBox::No);
    QVERIFY(trigger(*_window, "deleteAction"));
    QVERIFY(waitIdle());
    QCOMPARE(readFile(path), created);
    QVERIFY(_answerer->seen.last().contains(QStringLiteral("Do you really want to remove this element?")));
    _answerer->answer(QMessageBox::Yes);
    QVERIFY(trigger(*_window, "deleteAction"));
    QVERIFY(waitIdle());
    QCOMPARE(readFile(path), sample + '\n');
    QVERIFY(_window->currentElement());
    QCOMPARE(_window->currentElement()->title(), path);
    QVERIFY(!chooseElement(*_window, {path, QStringLiteral("NEW.KEY")}, 200));
}

void TestKvtAdmin::leavingEditedKeyAsks_data()
{
    QTest::addColumn<int>("answer");
    QTest::addColumn<QString>("current");
    QTest::addColumn<QByteArray>("onDisk");
    QTest::addColumn<QString>("valueShown");

    const QByteArray saved = QByteArray(sample).replace("NAME = value", "NAME = edited");
    QTest::newRow("save") << int(QMessageBox::Save) << "SPACED" << saved << "far";
    QTest::newRow("discard") << int(QMessageBox::Discard) << "SPACED" << sample << "far";
    QTest::newRow("cancel") << int(QMessageBox::Cancel) << "NAME" << sample << "edited";
}

void TestKvtAdmin::leavingEditedKeyAsks()
{
    QFETCH(int, answer);
    QFETCH(QString, current);
    QFETCH(QByteArray, onDisk);
    QFETCH(QString, valueShown);

    open({QStringLiteral("sample.conf")});
    const QString path = _sandbox->path(QStringLiteral("sample.conf"));
    QVERIFY(chooseElement(*_window, {path, QStringLiteral("NAME")}));
    typeInto(edit(*_window, "_valueLineEdit"), QStringLiteral("edited"));
    QVERIFY(action(*_window, "applyAction")->isEnabled());

    _answerer->answer(QMessageBox::StandardButton(answer));
    chooseElement(*_window, {path, QStringLiteral("SPACED")});
    QVERIFY(waitIdle());
    QVERIFY2(_answerer->seen.size() == 1, qPrintable(_answerer->seen.join(QLatin1Char('\n'))));
    QVERIFY(_answerer->seen.first().startsWith(QStringLiteral("Unsaved changes|")));
    QCOMPARE(_window->currentElement()->title(), current);
    QCOMPARE(edit(*_window, "_valueLineEdit")->text(), valueShown);
    QCOMPARE(readFile(path), onDisk);
    QCOMPARE(_window->shownEditWidget()->isChanged(), answer == QMessageBox::Cancel);
}

void TestKvtAdmin::failingTaskOpensTaskDialog_data()
{
    QTest::addColumn<bool>("removeFile");
    QTest::addColumn<QString>("message");

    // Root writes through any mode bits: a folder in the way of the work
    // copy makes the rewrite refuse for root and everyone else alike.
    QTest::newRow("unwritable") << false << "sample.conf.tmp\" is not a regular file of its own";
    QTest::newRow("file removed") << true << "sample.conf\" not exists";
}

void TestKvtAdmin::failingTaskOpensTaskDialog()
{
    QFETCH(bool, removeFile);
    QFETCH(QString, message);

    open({QStringLiteral("sample.conf")});
    const QString path = _sandbox->path(QStringLiteral("sample.conf"));
    QVERIFY(chooseElement(*_window, {path, QStringLiteral("NAME")}));
    if (removeFile) {
        QVERIFY(QFile::remove(path));
    } else {
        QVERIFY(QFile::setPermissions(path, QFile::ReadOwner | QFile::ReadGroup | QFile::ReadOther));
        QVERIFY(QDir().mkdir(path + QStringLiteral(".tmp")));
    }
    typeInto(edit(*_window, "_valueLineEdit"), QStringLiteral("lost?"));
    QVERIFY(trigger(*_window, "applyAction"));
    QVERIFY(waitIdle());

    TaskObserverDialog *dialog = TaskObserver::instance()->dialog();
    QTRY_VERIFY(dialog->isVisible());
    screenshot(dialog, QStringLiteral("kvt-admin-failed-task-") + QTest::currentDataTag());
    const QStringList rows = taskRows();
    QVERIFY2(rows.size() == 1, qPrintable(rows.join(QLatin1Char('\n'))));
    QVERIFY2(rows.first().startsWith(QStringLiteral("1|")) && rows.first().contains(message), qPrintable(rows.first()));
    // Nothing lost: the file is as it was, the edit is still there to apply.
    if (!removeFile)
        QCOMPARE(readFile(path), sample);
    QVERIFY(_window->shownEditWidget()->isChanged());
    dialog->reject();
    QDir(path + QStringLiteral(".tmp")).removeRecursively();
    _answerer->answer(QMessageBox::Discard);
}

void TestKvtAdmin::linesThatCannotBeChanged()
{
    const QByteArray odd = "DUP = one\n"
                           "DUP = two\n"
                           "BAD = caf\xe9\n"
                           "LONG = " + QByteArray(40000, 'x') + "\n"
                           "HASH = a#b\n";
    const QString path = _sandbox->write(QStringLiteral("odd.conf"), odd);
    open({QStringLiteral("odd.conf")});
    QVERIFY(chooseElement(*_window, {path}));
    // The read warns about the lines it will not change, in the task dialog.
    TaskObserverDialog *dialog = TaskObserver::instance()->dialog();
    QTRY_VERIFY(dialog->isVisible());
    const QString report = taskRows().join(QLatin1Char('\n'));
    QVERIFY2(report.startsWith(QStringLiteral("3|")), qPrintable(report));
    QVERIFY(report.contains(QStringLiteral("the key \"DUP\" is set 2 times (lines 1, 2)")));
    QVERIFY(report.contains(QStringLiteral("Line 3 is not valid text")));
    QVERIFY(report.contains(QStringLiteral("Line 4 is longer than 32767 characters")));
    dialog->reject();

    // The second of two lines of one key is changed alone.
    QVERIFY(chooseElement(*_window, {path, QStringLiteral("DUP = two")}));
    typeInto(edit(*_window, "_valueLineEdit"), QStringLiteral("zwei"));
    QVERIFY(trigger(*_window, "applyAction"));
    QVERIFY(waitIdle());
    QByteArray expected = QByteArray(odd).replace("DUP = two", "DUP = zwei");
    QCOMPARE(readFile(path), expected);

    // Lines that cannot be written back as they are offer no change.
    for (const QString &key : {QStringLiteral("BAD"), QStringLiteral("LONG")}) {
        QVERIFY(chooseElement(*_window, {path, key}));
        QVERIFY(edit(*_window, "_valueLineEdit")->isReadOnly());
        QVERIFY(!action(*_window, "applyAction")->isEnabled());
        QVERIFY(!_window->findChild<QLabel *>(QStringLiteral("_messageLabel"))->text().isEmpty());
    }
    // A "#" in a value would start a comment: refused before anything is written.
    QVERIFY(chooseElement(*_window, {path, QStringLiteral("HASH")}));
    QCOMPARE(edit(*_window, "_valueLineEdit")->text(), QStringLiteral("a"));
    QCOMPARE(edit(*_window, "_commentLineEdit")->text(), QStringLiteral("b"));
    typeInto(edit(*_window, "_valueLineEdit"), QStringLiteral("x#y"));
    QVERIFY(!action(*_window, "applyAction")->isEnabled());
    QVERIFY(_window->findChild<QLabel *>(QStringLiteral("_messageLabel"))->text().contains(QLatin1Char('#')));
    // A line can be deleted whatever it holds.
    _answerer->answer(QMessageBox::Discard);
    QVERIFY(chooseElement(*_window, {path, QStringLiteral("BAD")}));
    _answerer->answer(QMessageBox::Yes);
    QVERIFY(trigger(*_window, "deleteAction"));
    QVERIFY(waitIdle());
    QCOMPARE(readFile(path), expected.replace("BAD = caf\xe9\n", ""));
}

void TestKvtAdmin::pluginDialogListsRefusedFile()
{
    Sandbox plugins;
    QVERIFY(QFile::link(QStringLiteral(KVT_ADMIN_PLUGIN_DIR "/conffiles.so"), plugins.path(QStringLiteral("conffiles.so"))));
    plugins.write(QStringLiteral("broken.so"), "not a shared object\n");
    _sandbox->manage({QStringLiteral("sample.conf")});
    _window = openMainWindow({plugins.path(QString())});
    QCOMPARE(_window->pluginContainer()->modules().size(), 1);

    QVERIFY(trigger(*_window, "pluginDialogAction"));
    auto *dialog = _window->findChild<QDialog *>(QStringLiteral("PluginDialog"));
    QVERIFY(dialog);
    QTRY_VERIFY(dialog->isVisible());
    PluginModel *model = _window->pluginContainer()->pluginModel();
    QAbstractItemModelTester tester(model, QAbstractItemModelTester::FailureReportingMode::QtTest);
    QStringList rows;
    for (int row = 0; row < model->rowCount(); ++row)
        rows << model->index(row, 0).data().toString() + QLatin1Char('|') + model->index(row, 1).data().toString();
    rows.sort();
    QCOMPARE(rows.size(), 2);
    // A refused file is listed by its path, with the reason beside it.
    QVERIFY2(rows.at(0).contains(QStringLiteral("/broken.so|")) && !rows.at(0).endsWith(QLatin1Char('|')),
             qPrintable(rows.at(0)));
    QVERIFY2(rows.at(1).startsWith(QStringLiteral("Configuration files|")), qPrintable(rows.at(1)));
    screenshot(dialog, QStringLiteral("kvt-admin-plugin-dialog"));
    dialog->close();
}

QTEST_MAIN(TestKvtAdmin)
#include "tst_kvtadmin.moc"
