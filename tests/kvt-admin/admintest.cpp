// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#include "admintest.h"

#include "mainwindow.h"

#include <kvt-common/element.h>
#include <kvt-common/elementtreeview.h>
#include <kvt-common/module.h>
#include <kvt-common/plugincontainer.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/taskobserverdialog.h>
#include <kvt-common/treenodemodel.h>

#include <QAction>
#include <QApplication>
#include <QDeadlineTimer>
#include <QDir>
#include <QFile>
#include <QLineEdit>
#include <QSettings>
#include <QTest>
#include <QToolBar>
#include <QTreeView>

namespace AdminTest {

namespace {

// Sandboxes live in the test's own home, made first if need be.
QString sandboxTemplate()
{
    const QString home = qEnvironmentVariable("KVT_TEST_HOME", QDir::tempPath());
    QDir().mkpath(home);
    return QDir(home).filePath(QStringLiteral("sandbox-XXXXXX"));
}

} // namespace

Sandbox::Sandbox()
    : _dir(sandboxTemplate())
{
}

QString Sandbox::path(const QString &name) const
{
    return QDir::isAbsolutePath(name) ? name : _dir.filePath(name);
}

QString Sandbox::write(const QString &name, const QByteArray &bytes)
{
    const QString file = path(name);
    QFile out(file);
    if (!out.open(QIODevice::WriteOnly | QIODevice::Truncate) || out.write(bytes) != bytes.size())
        qFatal("cannot write %s", qPrintable(file));
    out.close();
    QFile::setPermissions(file, QFile::ReadOwner | QFile::WriteOwner | QFile::ReadGroup | QFile::ReadOther);
    return file;
}

void Sandbox::manage(const QStringList &names)
{
    QStringList files;
    for (const QString &name : names)
        files << path(name);
    QSettings settings;
    settings.setValue(QStringLiteral("conffiles/files"), files);
    settings.sync();
}

QByteArray readFile(const QString &path)
{
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray("<missing>");
}

std::unique_ptr<MainWindow> openMainWindow(const QStringList &directories)
{
    auto window = std::make_unique<MainWindow>();
    window->resize(1100, 600);
    window->show();
    if (!QTest::qWaitForWindowExposed(window.get()))
        qWarning("the main window was not exposed");
    window->loadPlugins(directories.isEmpty() ? QStringList{QStringLiteral(KVT_ADMIN_PLUGIN_DIR)} : directories);
    waitIdle();
    return window;
}

bool waitIdle(int timeoutMs)
{
    QDeadlineTimer deadline(timeoutMs);
    int quiet = 0;
    // Idle twice in a row, with events processed in between: work the
    // window defers to the event loop (a selection settling, then the read
    // it starts) has had its turn.
    while (quiet < 2) {
        QTest::qWait(10);
        // The block dialog goes with the last task; until then it holds the
        // window's input.
        QWidget *modal = QApplication::activeModalWidget();
        const bool blocked = modal && modal->inherits("BlockDialog");
        quiet = MainWindow::tasksIdle() && !blocked ? quiet + 1 : 0;
        if (quiet == 0 && deadline.hasExpired())
            return false;
    }
    return true;
}

bool chooseModule(MainWindow &window, const QString &id)
{
    QTreeView *view = window.moduleView();
    auto *model = window.pluginContainer()->treeNodeModel();
    for (TreeNode *node : window.pluginContainer()->modules()) {
        if (node->id() != id)
            continue;
        const QModelIndex index = model->treeNodeToIndex(node);
        view->scrollTo(index);
        QTest::mouseClick(view->viewport(), Qt::LeftButton, Qt::NoModifier, view->visualRect(index).center());
        return waitIdle() && window.currentModule() == node;
    }
    return false;
}

namespace {

QModelIndex findChild(QAbstractItemModel *model, const QModelIndex &parent, const QString &name)
{
    for (int row = 0; row < model->rowCount(parent); ++row) {
        const QModelIndex index = model->index(row, 0, parent);
        if (index.data(Qt::UserRole + 4).toString() == name || index.data().toString() == name)
            return index;
    }
    return QModelIndex();
}

} // namespace

Element *chooseElement(MainWindow &window, const QStringList &path, int timeoutMs)
{
    ElementTreeView *view = window.elementView();
    QAbstractItemModel *model = view->model();
    QModelIndex parent;
    for (const QString &name : path) {
        QDeadlineTimer deadline(timeoutMs);
        QModelIndex index = findChild(model, parent, name);
        while (!index.isValid() && !deadline.hasExpired()) {
            if (parent.isValid() && model->canFetchMore(parent))
                view->expand(parent);
            QTest::qWait(20);
            index = findChild(model, parent, name);
        }
        if (!index.isValid())
            return nullptr;
        const bool last = &name == &path.last();
        if (!last && model->rowCount(index) > 0) {
            // Already read: open it, as a person would, without leaving
            // the element on display.
            view->expand(index);
        } else {
            view->scrollTo(index);
            QTest::mouseClick(view->viewport(), Qt::LeftButton, Qt::NoModifier, view->visualRect(index).center());
            if (!waitIdle())
                return nullptr;
        }
        parent = model->index(index.row(), 0, index.parent());
    }
    return window.currentElement();
}

QAction *action(MainWindow &window, const char *objectName)
{
    return window.findChild<QAction *>(QLatin1String(objectName));
}

bool trigger(MainWindow &window, const char *objectName)
{
    QAction *found = action(window, objectName);
    if (!found || !found->isEnabled())
        return false;
    const auto bars = window.findChildren<QToolBar *>();
    for (QToolBar *bar : bars) {
        if (QWidget *button = bar->widgetForAction(found)) {
            if (button->isVisible()) {
                QTest::mouseClick(button, Qt::LeftButton);
                return true;
            }
        }
    }
    found->trigger();
    return true;
}

void typeInto(QWidget *edit, const QString &text)
{
    QTest::mouseClick(edit, Qt::LeftButton);
    QTest::keyClick(edit, Qt::Key_A, Qt::ControlModifier);
    if (text.isEmpty())
        QTest::keyClick(edit, Qt::Key_Delete);
    else
        QTest::keyClicks(edit, text);
}

QString screenshot(QWidget *widget, const QString &name)
{
    const QString dir = QStringLiteral(KVT_ADMIN_SCREENSHOT_DIR);
    QDir().mkpath(dir);
    const QString file = QDir(dir).filePath(name + QStringLiteral(".png"));
    widget->grab().save(file);
    return file;
}

} // namespace AdminTest
