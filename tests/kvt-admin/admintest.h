// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#ifndef KVT_ADMINTEST_H
#define KVT_ADMINTEST_H

#include <QByteArray>
#include <QMessageBox>
#include <QString>
#include <QStringList>
#include <QTemporaryDir>

#include <memory>

class Element;
class MainWindow;
class QAction;
class QWidget;

/*!
 * Helpers of the kvt-admin end-to-end tests: a sandbox of configuration
 * files, and the moves of a person at the main window (choose a module,
 * choose an element, trigger an action, wait until the tasks are done,
 * answer the next message box).
 */
namespace AdminTest {

//! Files in a temporary folder, listed as the files of the conffiles module.
class Sandbox
{
public:
    Sandbox();
    QString path(const QString &name) const;
    //! Writes \a bytes to \a name (mode 0644) and returns its path.
    QString write(const QString &name, const QByteArray &bytes);
    //! Makes \a names (in this folder; a path is taken as it is) the files
    //! of the conffiles module.
    void manage(const QStringList &names);
    bool isValid() const { return _dir.isValid(); }

private:
    QTemporaryDir _dir;
};

QByteArray readFile(const QString &path);

//! A shown main window with the build tree's plugins (or \a directories) loaded.
std::unique_ptr<MainWindow> openMainWindow(const QStringList &directories = {});

//! Waits until no task runs and no modal window of the observer is up.
bool waitIdle(int timeoutMs = 20000);

//! Clicks the module with the id \a id in the module view.
bool chooseModule(MainWindow &window, const QString &id);

/*!
 * Clicks, level by level, the elements named by \a path in the element
 * view: each name is an element's title or the text the tree shows for it.
 * A level whose children are shown already is only expanded, not clicked.
 * Waits for the reads its clicks start. The element of the last name, or
 * null when one was not found in time.
 */
Element *chooseElement(MainWindow &window, const QStringList &path, int timeoutMs = 10000);

//! The action of the window with this object name.
QAction *action(MainWindow &window, const char *objectName);
/*!
 * Triggers an action as a person would: clicks its tool bar button when it
 * has one, else triggers it. False when it is disabled.
 */
bool trigger(MainWindow &window, const char *objectName);

//! Selects the text of \a edit and types \a text over it.
void typeInto(QWidget *edit, const QString &text);

//! Saves a picture of \a widget under the screenshot folder of the tests.
QString screenshot(QWidget *widget, const QString &name);

} // namespace AdminTest

#endif
