// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#include "mainwindow.h"

#include "moduleelementfilter.h"

#include <kvt-common/element.h>
#include <kvt-common/elementcontainer.h>
#include <kvt-common/elementtreeview.h>
#include <kvt-common/elementwidgetcontainer2.h>
#include <kvt-common/module.h>
#include <kvt-common/operationtype.h>
#include <kvt-common/plugincontainer.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/treenodemodel.h>
#include <kvt-common/vieweditelementwidget.h>

#include <QAbstractButton>
#include <QAction>
#include <QApplication>
#include <QCloseEvent>
#include <QDeadlineTimer>
#include <QDir>
#include <QDirIterator>
#include <QFile>
#include <QFileInfo>
#include <QHeaderView>
#include <QIcon>
#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>
#include <QPluginLoader>
#include <QSettings>
#include <QSplitter>
#include <QStatusBar>
#include <QTemporaryDir>
#include <QTimer>
#include <QToolBar>
#include <QTreeView>
#include <QVBoxLayout>

namespace {

const char geometryKey[] = "mainWindow/geometry";
const char stateKey[] = "mainWindow/state";
const char splitterKey[] = "mainWindow/splitter";

QWidget *titled(const QString &title, QWidget *content)
{
    auto *box = new QWidget;
    auto *layout = new QVBoxLayout(box);
    layout->setContentsMargins(2, 2, 2, 2);
    auto *label = new QLabel(title);
    label->setBuddy(content);
    layout->addWidget(label);
    layout->addWidget(content);
    return box;
}

QAction *makeAction(QObject *parent, const char *objectName, const QString &icon, const QString &text,
                    const QKeySequence &shortcut = QKeySequence())
{
    auto *action = new QAction(QIcon::fromTheme(icon), text, parent);
    action->setObjectName(QLatin1String(objectName));
    if (!shortcut.isEmpty())
        action->setShortcut(shortcut);
    return action;
}

} // namespace

MainWindow::MainWindow(QWidget *parent)
    : QMainWindow(parent)
{
    setObjectName(QStringLiteral("kvtAdminMainWindow"));
    setWindowTitle(tr("System administration"));
    setWindowIcon(QIcon::fromTheme(QStringLiteral("preferences-system")));

    // The observer of the process; its dialogs open over this window.
    TaskObserver::instance(this);

    _plugins = new PluginContainer(this);
    _elements = new ElementContainer(this);

    _moduleView = new QTreeView;
    _moduleView->setObjectName(QStringLiteral("moduleView"));
    _moduleView->setModel(_plugins->treeNodeModel());
    _moduleView->setContextMenuPolicy(Qt::CustomContextMenu);
    _moduleView->setSelectionMode(QAbstractItemView::SingleSelection);
    _moduleView->header()->setSectionResizeMode(QHeaderView::ResizeToContents);

    _elementFilter = new ModuleElementFilter(this);
    _elementFilter->setSourceModel(_elements->treeNodeModel());
    _elementView = new ElementTreeView;
    _elementView->setObjectName(QStringLiteral("elementView"));
    _elementView->setModel(_elementFilter);
    _elementView->setSelectionMode(QAbstractItemView::SingleSelection);
    _elementView->setUniformRowHeights(true);

    _widgetContainer = new ElementWidgetContainer2;
    _widgetContainer->setObjectName(QStringLiteral("widgetContainer"));

    _splitter = new QSplitter;
    _splitter->setObjectName(QStringLiteral("mainSplitter"));
    _splitter->addWidget(titled(tr("&Modules"), _moduleView));
    _splitter->addWidget(titled(tr("&Elements"), _elementView));
    _splitter->addWidget(_widgetContainer);
    _splitter->setStretchFactor(0, 1);
    _splitter->setStretchFactor(1, 2);
    _splitter->setStretchFactor(2, 3);
    setCentralWidget(_splitter);

    createActions();
    createMenus();

    connect(_plugins, SIGNAL(nodeContainerAboutToBeReset()), this, SLOT(pluginsAboutToBeReset()));
    connect(_plugins, SIGNAL(nodeContainerReset(const TreeNode *)), this, SLOT(pluginsReset()));
    connect(_plugins, SIGNAL(contentElementWidgetChanged(int)), this, SLOT(updateActions()));
    connect(_plugins, SIGNAL(customContextMenuRequested(QPoint)), this, SLOT(showPluginMenu(QPoint)));
    connect(_elements, SIGNAL(setCurrentNode(TreeNode *)), this, SLOT(selectNode(TreeNode *)));
    connect(_elements, SIGNAL(expandCurrentNode(TreeNode *)), this, SLOT(expandNode(TreeNode *)));
    connect(_moduleView->selectionModel(), SIGNAL(selectionChanged(QItemSelection, QItemSelection)), this,
            SLOT(moduleSelectionChanged()));
    connect(_moduleView, SIGNAL(customContextMenuRequested(QPoint)), this, SLOT(showModuleMenu(QPoint)));
    connect(_elementView->selectionModel(), SIGNAL(selectionChanged(QItemSelection, QItemSelection)), this,
            SLOT(elementSelectionChanged()));
    connect(_elementView, SIGNAL(customContextMenuRequested(QPoint)), this, SLOT(showElementMenu(QPoint)));
    for (const char *signal : {SIGNAL(elementContextOperationChangedFocused(Element *)),
                               SIGNAL(elementContextOperationChangedSelected(Element *)),
                               SIGNAL(elementContextOperationChangedChanged(Element *))})
        connect(_elementView, signal, this, SLOT(updateActions()));
    connect(_elementFilter, SIGNAL(rowsAboutToBeRemoved(QModelIndex, int, int)), this,
            SLOT(elementRowsAboutToBeRemoved(QModelIndex, int, int)));
    connect(_elementFilter, SIGNAL(modelAboutToBeReset()), this, SLOT(forgetShownElement()));
    connect(_widgetContainer, SIGNAL(elementContextOperationChanged(Element *)), this, SLOT(updateActions()));
    connect(_widgetContainer, SIGNAL(elementWidgetChanged(ElementWidget *)), this, SLOT(updateActions()));

    statusBar();
    resize(1100, 640);
    loadSettings();
    updateActions();
}

MainWindow::~MainWindow()
{
    saveSettings();
    // Widgets go back to their modules, and modules and their elements go,
    // while the views that show them still exist.
    _widgetContainer->reset();
    _plugins->unloadPlugins();
}

void MainWindow::createActions()
{
    _createAction = makeAction(this, "createAction", QStringLiteral("list-add"), tr("&Create"),
                               QKeySequence::New);
    _createAction->setToolTip(tr("Create a new element here"));
    _deleteAction = makeAction(this, "deleteAction", QStringLiteral("list-remove"), tr("&Delete"),
                               QKeySequence::Delete);
    _deleteAction->setToolTip(tr("Delete the current element"));
    _applyAction = makeAction(this, "applyAction", QStringLiteral("dialog-ok-apply"), tr("&Apply"),
                              QKeySequence(Qt::CTRL | Qt::Key_S));
    _applyAction->setToolTip(tr("Write the changes"));
    _cancelAction = makeAction(this, "cancelAction", QStringLiteral("dialog-cancel"), tr("Ca&ncel"));
    _cancelAction->setToolTip(tr("Forget the changes"));
    _rereadAction = makeAction(this, "rereadAction", QStringLiteral("view-refresh"), tr("&Reread"),
                               QKeySequence::Refresh);
    _rereadAction->setToolTip(tr("Read the current element again from the system"));
    _pluginDialogAction = makeAction(this, "pluginDialogAction", QStringLiteral("preferences-plugin"),
                                     tr("&Plugins..."));
    _taskDialogAction = makeAction(this, "taskDialogAction", QStringLiteral("view-list-details"),
                                   tr("&Tasks..."));
    _quitAction = makeAction(this, "quitAction", QStringLiteral("application-exit"), tr("&Quit"),
                             QKeySequence::Quit);

    connect(_createAction, SIGNAL(triggered()), this, SLOT(createElement()));
    connect(_deleteAction, SIGNAL(triggered()), this, SLOT(deleteElement()));
    connect(_applyAction, SIGNAL(triggered()), this, SLOT(applyChanges()));
    connect(_cancelAction, SIGNAL(triggered()), this, SLOT(cancelChanges()));
    connect(_rereadAction, SIGNAL(triggered()), this, SLOT(reread()));
    connect(_pluginDialogAction, SIGNAL(triggered()), _plugins, SLOT(showPluginDialog()));
    connect(_taskDialogAction, SIGNAL(triggered()), TaskObserver::instance(), SLOT(openTaskObserveDialog()));
    connect(_quitAction, SIGNAL(triggered()), this, SLOT(close()));

    // The delete key belongs to the line edits while one has the focus.
    _deleteAction->setShortcutContext(Qt::WidgetWithChildrenShortcut);
    _elementView->addAction(_deleteAction);
}

void MainWindow::createMenus()
{
    QMenu *file = menuBar()->addMenu(tr("&File"));
    file->addAction(_pluginDialogAction);
    file->addAction(_taskDialogAction);
    file->addSeparator();
    file->addAction(_quitAction);

    QMenu *element = menuBar()->addMenu(tr("&Element"));
    element->addActions({_createAction, _deleteAction});
    element->addSeparator();
    element->addActions({_applyAction, _cancelAction, _rereadAction});

    _toolBar = addToolBar(tr("Element"));
    _toolBar->setObjectName(QStringLiteral("elementToolBar"));
    _toolBar->setToolButtonStyle(Qt::ToolButtonTextBesideIcon);
    _toolBar->addActions({_createAction, _deleteAction});
    _toolBar->addSeparator();
    _toolBar->addActions({_applyAction, _cancelAction, _rereadAction});
    _elementActionsSeparator = _toolBar->addSeparator();
}

// ---- plugins ---------------------------------------------------------------

void MainWindow::loadPlugins(const QStringList &directories)
{
    _missingDirectories.clear();
    QStringList present;
    for (const QString &directory : directories) {
        if (QFileInfo(directory).isDir())
            present << QDir(directory).absolutePath();
        else
            _missingDirectories << directory;
    }
    present.removeDuplicates();

    QString directory;
    if (present.size() == 1) {
        directory = present.first();
    } else if (!present.isEmpty()) {
        // The container loads one folder: the plugin files of all folders
        // are linked into one private folder, each under a name of its own.
        _mergedDirectory = std::make_unique<QTemporaryDir>(QDir::temp().filePath(QStringLiteral("kvt-admin-XXXXXX")));
        directory = _mergedDirectory->path();
        int number = 0;
        for (const QString &folder : qAsConst(present)) {
            QDirIterator it(folder, {QStringLiteral("*.so")}, QDir::Files, QDirIterator::Subdirectories);
            while (it.hasNext()) {
                const QString file = it.next();
                const QString link = QDir(directory).filePath(
                    QStringLiteral("%1-%2").arg(++number, 3, 10, QLatin1Char('0')).arg(QFileInfo(file).fileName()));
                QFile::link(QFileInfo(file).absoluteFilePath(), link);
            }
        }
    } else {
        directory = directories.isEmpty() ? QString() : directories.first();
    }
    if (present.isEmpty() && !directories.isEmpty()) {
        // Nothing to load; the container would say so in a box of its own.
        _plugins->unloadPlugins();
        statusBar()->showMessage(tr("No plugin folder: %1").arg(_missingDirectories.join(QStringLiteral(", "))));
        return;
    }
    QApplication::setOverrideCursor(Qt::WaitCursor);
    _plugins->loadPlugins(directory);
    QApplication::restoreOverrideCursor();

    int accepted = 0;
    for (const auto &entry : _plugins->plugins())
        accepted += entry.second ? 1 : 0;
    statusBar()->showMessage(tr("%1 plugin files tried, %2 accepted, %3 modules")
                                 .arg(_plugins->plugins().size())
                                 .arg(accepted)
                                 .arg(_plugins->modules().size()));
}

QString MainWindow::pluginFilePath(int entry) const
{
    const auto &plugins = _plugins->plugins();
    if (entry < 0 || entry >= plugins.size())
        return QString();
    const QFileInfo info(plugins.at(entry).first->fileName());
    return info.isSymLink() ? info.symLinkTarget() : info.absoluteFilePath();
}

void MainWindow::pluginsAboutToBeReset()
{
    _widgetContainer->reset();
    _shownElement = nullptr;
    _shownModule = nullptr;
    _elementFilter->setModule(nullptr);
}

void MainWindow::pluginsReset()
{
    _elements->pluginContainerReset(_plugins->rootNode());
    _moduleView->expandAll();
    // The first module is chosen, so its elements are on show at once.
    const QModelIndex first = _plugins->treeNodeModel()->index(0, 0);
    if (first.isValid())
        _moduleView->selectionModel()->setCurrentIndex(first, QItemSelectionModel::ClearAndSelect
                                                                  | QItemSelectionModel::Rows);
    updateActions();
}

// ---- selection -------------------------------------------------------------

Element *MainWindow::currentElement() const
{
    return _elementFilter->toElement(_elementView->selectionModel()->selection());
}

Module *MainWindow::currentModule() const
{
    auto *model = _plugins->treeNodeModel();
    return qobject_cast<Module *>(model->toTreeNode(_moduleView->selectionModel()->selection()));
}

ViewEditElementWidget *MainWindow::shownEditWidget() const
{
    return qobject_cast<ViewEditElementWidget *>(_widgetContainer->currentElementWidget());
}

void MainWindow::moduleSelectionChanged()
{
    if (_restoring)
        return;
    Module *module = currentModule();
    if (module == _shownModule)
        return;
    if (!maySwitchAway()) {
        restoreModuleSelection();
        return;
    }
    _widgetContainer->reset();
    _shownElement = nullptr;
    _shownModule = module;
    _elementFilter->setModule(module);
    // Module actions: those the module offers for every element type.
    updateActions();
}

void MainWindow::elementSelectionChanged()
{
    if (_restoring || _selectionPending)
        return;
    // Settled once the input event that changed the selection is over: a
    // question asked in the middle of a mouse click would see the rest of
    // the click change the selection again.
    _selectionPending = true;
    QTimer::singleShot(0, this, SLOT(settleElementSelection()));
}

void MainWindow::settleElementSelection()
{
    _selectionPending = false;
    Element *element = currentElement();
    if (element && element == _shownElement && _widgetContainer->currentElementWidget()) {
        updateActions();
        return;
    }
    if (!maySwitchAway()) {
        restoreElementSelection();
        return;
    }
    showCurrentElement();
}

void MainWindow::showCurrentElement()
{
    const QItemSelection selection = _elementView->selectionModel()->selection();
    _widgetContainer->setCurrentElementWidget(selection, EditElementRole);
    Element *element = currentElement();
    _shownElement = element;
    if (element && element->canFetchMore()) {
        // Choosing a container reads its content, as expanding it does.
        const QModelIndex index = _elementFilter->treeNodeToIndex(element);
        _elementFilter->fetchMore(index);
        _elementView->expand(index);
    }
    updateActions();
}

void MainWindow::restoreElementSelection()
{
    _restoring = true;
    const QModelIndex index = _shownElement ? _elementFilter->treeNodeToIndex(_shownElement) : QModelIndex();
    if (index.isValid())
        _elementView->selectionModel()->setCurrentIndex(
            index, QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
    else
        _elementView->selectionModel()->clearSelection();
    _restoring = false;
}

void MainWindow::restoreModuleSelection()
{
    _restoring = true;
    auto *model = _plugins->treeNodeModel();
    const QModelIndex index = _shownModule ? model->treeNodeToIndex(_shownModule) : QModelIndex();
    if (index.isValid())
        _moduleView->selectionModel()->setCurrentIndex(
            index, QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
    else
        _moduleView->selectionModel()->clearSelection();
    _restoring = false;
}

void MainWindow::selectNode(TreeNode *node)
{
    // A task asks for this node, after a creation or a removal: a creation
    // form that is still on display has done its work.
    if (ViewEditElementWidget *widget = shownEditWidget()) {
        if (widget->role() == CreateElementRole)
            widget->setUnchanged();
    }
    const QModelIndex index = _elementFilter->treeNodeToIndex(node);
    if (!index.isValid())
        return;
    _elementView->scrollTo(index);
    _elementView->selectionModel()->setCurrentIndex(index,
                                                    QItemSelectionModel::ClearAndSelect | QItemSelectionModel::Rows);
}

void MainWindow::expandNode(TreeNode *node)
{
    const QModelIndex index = _elementFilter->treeNodeToIndex(node);
    if (index.isValid())
        _elementView->expand(index);
}

void MainWindow::elementRowsAboutToBeRemoved(const QModelIndex &parent, int first, int last)
{
    if (!_shownElement)
        return;
    // The shown element (or an ancestor) is going: its widget must not keep it.
    for (int row = first; row <= last; ++row) {
        const TreeNode *going = _elementFilter->toTreeNode(_elementFilter->index(row, 0, parent));
        for (const TreeNode *node = _shownElement; node; node = node->parentNode()) {
            if (node == going) {
                forgetShownElement();
                return;
            }
        }
    }
}

void MainWindow::forgetShownElement()
{
    _widgetContainer->reset();
    _shownElement = nullptr;
    updateActions();
}

bool MainWindow::maySwitchAway()
{
    ViewEditElementWidget *widget = shownEditWidget();
    if (!widget || !widget->isChanged())
        return true;
    QMessageBox box(QMessageBox::Question, tr("Unsaved changes"),
                    widget->role() == CreateElementRole
                        ? tr("The new element is not created yet.\nCreate it before leaving?")
                        : tr("The changes to \"%1\" are not applied.\nApply them before leaving?")
                              .arg(widget->caption()),
                    QMessageBox::Save | QMessageBox::Discard | QMessageBox::Cancel, this);
    box.setDefaultButton(QMessageBox::Cancel);
    if (!widget->isContentValid())
        box.button(QMessageBox::Save)->setEnabled(false);
    switch (box.exec()) {
    case QMessageBox::Save:
        widget->applyContentChanges();
        return true;
    case QMessageBox::Discard:
        widget->setUnchanged();
        return true;
    default:
        return false;
    }
}

// ---- actions ---------------------------------------------------------------

void MainWindow::updateActions()
{
    Element *element = currentElement();
    const quint64 operations = element ? element->availableOperations() : 0;
    ViewEditElementWidget *widget = shownEditWidget();
    const bool creating = widget && widget->role() == CreateElementRole;
    const bool changed = widget && widget->isChanged();

    _createAction->setEnabled((operations & CreateOperation) && !creating);
    _deleteAction->setEnabled((operations & DeleteOperation) && !creating);
    bool applicable = changed && widget->isContentValid() && !widget->isEditBlocked();
    if (applicable && !creating)
        applicable = widget->element() && (widget->element()->availableOperations() & UpdateOperation);
    _applyAction->setEnabled(applicable);
    _cancelAction->setEnabled(changed || creating);
    _rereadAction->setEnabled(element ? bool(operations & (ReadContentOperation | ReadPropertyOperation))
                                      : !_plugins->modules().isEmpty());

    // The module's own actions for the element's type follow the element.
    for (QAction *action : qAsConst(_moduleActions))
        _toolBar->removeAction(action);
    _moduleActions = element ? element->elementActions() : QList<QAction *>();
    _toolBar->addActions(_moduleActions);
}

void MainWindow::createElement()
{
    if (!_createAction->isEnabled() || !maySwitchAway())
        return;
    _widgetContainer->setCurrentElementWidget(_elementView->selectionModel()->selection(), CreateElementRole);
    if (!shownEditWidget())
        statusBar()->showMessage(tr("Nothing can be created here."), 5000);
    updateActions();
}

void MainWindow::deleteElement()
{
    Element *element = currentElement();
    if (!element || !(element->availableOperations() & DeleteOperation))
        return;
    const QMessageBox::StandardButton answer = QMessageBox::question(
        this, tr("Delete"), element->questionForRemove() + QStringLiteral("\n\n") + element->title(),
        QMessageBox::Yes | QMessageBox::No, QMessageBox::No);
    if (answer != QMessageBox::Yes)
        return;
    element->performOperation(DeleteOperation, nullptr, 0);
}

void MainWindow::applyChanges()
{
    ViewEditElementWidget *widget = shownEditWidget();
    if (!widget || !_applyAction->isEnabled())
        return;
    widget->applyContentChanges();
}

void MainWindow::cancelChanges()
{
    ViewEditElementWidget *widget = shownEditWidget();
    if (!widget)
        return;
    widget->setUnchanged();
    if (widget->role() == CreateElementRole)
        showCurrentElement();
    else
        widget->read();
    updateActions();
}

void MainWindow::reread()
{
    Element *element = currentElement();
    if (!element) {
        // Nothing chosen: every container of the shown module that has been
        // read already is read again.
        for (int row = 0; row < _elementFilter->rowCount(); ++row) {
            auto *top = _elementFilter->toElement(_elementFilter->index(row, 0));
            if (top && !top->requireLoad() && (top->availableOperations() & ReadContentOperation))
                top->performOperation(ReadContentOperation, nullptr, 0);
        }
        return;
    }
    if (!maySwitchAway())
        return;
    const quint64 operations = element->availableOperations();
    if (operations & ReadContentOperation)
        element->performOperation(ReadContentOperation, nullptr, 0);
    ViewEditElementWidget *widget = shownEditWidget();
    if (widget && widget->element() == element)
        widget->read();
    else if (operations & ReadPropertyOperation && !(operations & ReadContentOperation))
        element->performOperation(ReadPropertyOperation, nullptr, 0);
}

QMenu *MainWindow::elementMenu()
{
    auto *menu = new QMenu(this);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    menu->addActions({_createAction, _deleteAction});
    menu->addSeparator();
    menu->addActions({_applyAction, _cancelAction, _rereadAction});
    if (!_moduleActions.isEmpty()) {
        menu->addSeparator();
        menu->addActions(_moduleActions);
    }
    return menu;
}

void MainWindow::showElementMenu(const QPoint &pos)
{
    updateActions();
    elementMenu()->popup(_elementView->viewport()->mapToGlobal(pos));
}

void MainWindow::showPluginMenu(const QPoint &)
{
    // Relayed from a list widget of a module: the position is the widget's.
    updateActions();
    elementMenu()->popup(QCursor::pos());
}

void MainWindow::showModuleMenu(const QPoint &pos)
{
    auto *menu = new QMenu(this);
    menu->setAttribute(Qt::WA_DeleteOnClose);
    menu->addAction(_rereadAction);
    menu->addSeparator();
    menu->addActions({_pluginDialogAction, _taskDialogAction});
    menu->popup(_moduleView->viewport()->mapToGlobal(pos));
}

// ---- tasks -----------------------------------------------------------------

bool MainWindow::tasksIdle()
{
    return TaskObserver::instance()->runningCount() == 0;
}

bool MainWindow::waitForTasks(int timeoutMs)
{
    QDeadlineTimer deadline(timeoutMs);
    while (!tasksIdle()) {
        if (deadline.hasExpired())
            return false;
        QCoreApplication::processEvents(QEventLoop::AllEvents, 20);
        QCoreApplication::sendPostedEvents();
    }
    QCoreApplication::processEvents();
    return true;
}

bool MainWindow::readAllElements(int timeoutMs)
{
    QDeadlineTimer deadline(timeoutMs);
    QAbstractItemModel *model = _elements->treeNodeModel();
    for (;;) {
        QList<QModelIndex> pending{QModelIndex()};
        bool fetched = false;
        while (!pending.isEmpty()) {
            const QModelIndex parent = pending.takeLast();
            if (parent.isValid() && model->canFetchMore(parent)) {
                model->fetchMore(parent);
                fetched = true;
            }
            for (int row = 0; row < model->rowCount(parent); ++row)
                pending.append(model->index(row, 0, parent));
        }
        if (!waitForTasks(int(qMax<qint64>(0, deadline.remainingTime()))))
            return false;
        if (!fetched)
            return true;
    }
}

// ---- window ----------------------------------------------------------------

void MainWindow::closeEvent(QCloseEvent *event)
{
    if (!maySwitchAway()) {
        event->ignore();
        return;
    }
    saveSettings();
    QMainWindow::closeEvent(event);
}

void MainWindow::loadSettings()
{
    QSettings settings;
    restoreGeometry(settings.value(QLatin1String(geometryKey)).toByteArray());
    restoreState(settings.value(QLatin1String(stateKey)).toByteArray());
    if (!_splitter->restoreState(settings.value(QLatin1String(splitterKey)).toByteArray()))
        _splitter->setSizes({260, 320, 520});
}

void MainWindow::saveSettings() const
{
    QSettings settings;
    settings.setValue(QLatin1String(geometryKey), saveGeometry());
    settings.setValue(QLatin1String(stateKey), saveState());
    settings.setValue(QLatin1String(splitterKey), _splitter->saveState());
}
