// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#ifndef KVT_ADMIN_MAINWINDOW_H
#define KVT_ADMIN_MAINWINDOW_H

#include <kvt-common/element.h>
#include <kvt-common/module.h>

#include <QMainWindow>
#include <QPointer>
#include <QStringList>

#include <memory>

class ElementContainer;
class ElementTreeView;
class ElementWidgetContainer2;
class ModuleElementFilter;
class PluginContainer;
class QAction;
class QMenu;
class QSplitter;
class QTemporaryDir;
class QToolBar;
class QTreeView;
class TreeNode;
class ViewEditElementWidget;

/*!
 * The main window of kvt-admin: the module tree on the left, the elements
 * of the chosen module in the middle, the widgets of the chosen element on
 * the right, and the actions on the current element in a tool bar, a menu
 * and the views' context menus.
 *
 * Leaving an element whose widget holds unsaved changes asks first: apply,
 * discard, or stay.
 *
 * The window does not start worker threads (see WorkerThreads): the process
 * starts them once. Before the window goes, the tasks it started should
 * have finished (waitForTasks()).
 */
class MainWindow : public QMainWindow
{
    Q_OBJECT

public:
    explicit MainWindow(QWidget *parent = nullptr);
    ~MainWindow() override;

    /*!
     * Loads the plugins below \a directories. Folders that do not exist are
     * skipped and listed by missingDirectories(); with several folders, the
     * plugin files of all of them are loaded together.
     */
    void loadPlugins(const QStringList &directories);
    QStringList missingDirectories() const { return _missingDirectories; }
    //! The file a plugin entry of the container was loaded from.
    QString pluginFilePath(int entry) const;

    PluginContainer *pluginContainer() const { return _plugins; }
    ElementContainer *elementContainer() const { return _elements; }
    QTreeView *moduleView() const { return _moduleView; }
    ElementTreeView *elementView() const { return _elementView; }
    ElementWidgetContainer2 *widgetContainer() const { return _widgetContainer; }
    ModuleElementFilter *elementFilter() const { return _elementFilter; }

    //! The element of the element view's selection, or null.
    Element *currentElement() const;
    //! The module chosen in the module view, or null (all elements shown).
    Module *currentModule() const;
    //! The edit widget on display, or null.
    ViewEditElementWidget *shownEditWidget() const;

    //! True when no task of the process is running.
    static bool tasksIdle();
    //! Processes events until no task runs, for at most \a timeoutMs; true when idle.
    static bool waitForTasks(int timeoutMs);
    /*!
     * Reads every container element (as expanding them all would), level
     * by level, until none is left to read; at most \a timeoutMs. True when
     * everything was read in time.
     */
    bool readAllElements(int timeoutMs);

public Q_SLOTS:
    void updateActions();

protected:
    void closeEvent(QCloseEvent *event) override;

private Q_SLOTS:
    void moduleSelectionChanged();
    void elementSelectionChanged();
    void settleElementSelection();
    void selectNode(TreeNode *node);
    void expandNode(TreeNode *node);
    void createElement();
    void deleteElement();
    void applyChanges();
    void cancelChanges();
    void reread();
    void showElementMenu(const QPoint &pos);
    void showModuleMenu(const QPoint &pos);
    void showPluginMenu(const QPoint &pos);
    void pluginsAboutToBeReset();
    void pluginsReset();
    void elementRowsAboutToBeRemoved(const QModelIndex &parent, int first, int last);
    void forgetShownElement();

private:
    void createActions();
    void createMenus();
    //! Asks what to do with unsaved changes; false when the user stays.
    bool maySwitchAway();
    void showCurrentElement();
    void restoreElementSelection();
    void restoreModuleSelection();
    QMenu *elementMenu();
    void loadSettings();
    void saveSettings() const;

    PluginContainer *_plugins;
    ElementContainer *_elements;
    ModuleElementFilter *_elementFilter;
    QTreeView *_moduleView;
    ElementTreeView *_elementView;
    ElementWidgetContainer2 *_widgetContainer;
    QSplitter *_splitter;
    QToolBar *_toolBar;
    QAction *_createAction;
    QAction *_deleteAction;
    QAction *_applyAction;
    QAction *_cancelAction;
    QAction *_rereadAction;
    QAction *_pluginDialogAction;
    QAction *_taskDialogAction;
    QAction *_quitAction;
    QAction *_elementActionsSeparator;
    QList<QAction *> _moduleActions;
    QPointer<Element> _shownElement;
    QPointer<Module> _shownModule;
    bool _restoring = false;
    bool _selectionPending = false;
    QStringList _missingDirectories;
    std::unique_ptr<QTemporaryDir> _mergedDirectory;
};

#endif
