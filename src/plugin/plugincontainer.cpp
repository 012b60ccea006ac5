// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "plugincontainer.h"
#include "plugincontainer_p.h"

#include "module.h"
#include "moduleroottreenode.h"
#include "plugin.h"
#include "plugindialog.h"
#include "pluginmodel.h"
#include "treenodemodel.h"
#include "kvtlogging_p.h"

#include <QApplication>
#include <QDirIterator>
#include <QHash>
#include <QFileInfo>
#include <QMessageBox>
#include <QMetaMethod>
#include <QPluginLoader>
#include <QPointer>
#include <QPushButton>
#include <QWidget>

namespace {

// Why a loaded file was refused, kept on its loader: the loader itself
// reports no error for a file that loaded well.
const char refusalProperty[] = "_kvt_refusal";
// The sentence a refused plugin gives for itself (see Plugin).
const char unavailableReasonProperty[] = "unavailableReason";

// The two module signals the container re-emits, looked up once. Connecting
// by meta-method makes exactly the connections that the SIGNAL() form makes,
// without parsing four signatures for every module of every plugin.
struct RelayedSignals
{
    QMetaMethod moduleContent;
    QMetaMethod moduleMenu;
    QMetaMethod containerContent;
    QMetaMethod containerMenu;
};

QMetaMethod signalOf(const QMetaObject &meta, const char *signature)
{
    return meta.method(meta.indexOfSignal(QMetaObject::normalizedSignature(signature).constData()));
}

const RelayedSignals &relayedSignals()
{
    static const RelayedSignals relayed = {
        signalOf(Module::staticMetaObject, "contentElementWidgetChanged(int)"),
        signalOf(Module::staticMetaObject, "customContextMenuRequested(QPoint)"),
        signalOf(PluginContainer::staticMetaObject, "contentElementWidgetChanged(int)"),
        signalOf(PluginContainer::staticMetaObject, "customContextMenuRequested(QPoint)"),
    };
    return relayed;
}

// Loads in progress. Events are processed during a load, and an event may ask
// the same container to load or unload again: that request waits until the
// running load is done (the last request wins), instead of pulling the
// plugins out from under it.
struct LoadState
{
    enum Request { None, Load, Unload };
    Request deferred = None;
    QString deferredDirectory;
    bool ownUnload = false; // the unload that a load itself starts with
};

QHash<const PluginContainer *, LoadState> &loadStates()
{
    static QHash<const PluginContainer *, LoadState> states;
    return states;
}

void enableChangeButton(QWidget *dialog, bool enable)
{
    if (!dialog)
        return;
    if (auto *button = dialog->findChild<QPushButton *>(QStringLiteral("_changePushButton")))
        button->setEnabled(enable);
}

} // namespace

bool KvtPluginLoading::isLoading(const PluginContainer *container)
{
    return loadStates().contains(container);
}

PluginContainer::PluginContainer(QObject *parent)
    : NodeContainer(parent)
    , _availableOperationsClass(0)
    , _parentWidget(qobject_cast<QWidget *>(parent))
    , _pluginModel(nullptr)
    , _pluginDialog(nullptr)
{
    _pluginModel = new PluginModel(this, this);
    _rootNode = new ModuleRootTreeNode(this);
    connect(_rootNode, SIGNAL(setCurrentNode(TreeNode *)), this, SIGNAL(setCurrentNode(TreeNode *)));
    _treeNodeModel = new TreeNodeModel(_rootNode, this);
    _pluginDialog = new PluginDialog(this, _parentWidget);
}

PluginContainer::~PluginContainer()
{
    // Destroyed from an event during its own load: the load stops (it
    // watches this object) and the plugins go now.
    loadStates().remove(this);
    unloadPlugins();
    // With a parent widget the dialog belongs to that widget and may outlive
    // the container; it lets go of the container when the container is
    // destroyed.
    if (!_parentWidget)
        delete _pluginDialog;
    _pluginDialog = nullptr;
    // The model goes before the root it watches.
    delete _treeNodeModel;
    _treeNodeModel = nullptr;
}

void PluginContainer::loadPlugins(const QString &directory)
{
    if (loadStates().contains(this)) {
        LoadState &state = loadStates()[this];
        state.deferred = LoadState::Load;
        state.deferredDirectory = directory;
        qCWarning(KVT_PLUGIN, "PluginContainer::loadPlugins(\"%s\") called during a load: deferred until that load ends",
                  qPrintable(directory));
        return;
    }
    loadStates().insert(this, LoadState());
    enableChangeButton(_pluginDialog, false);
    const QPointer<PluginContainer> self(this);

    QString next = directory;
    LoadState::Request request = LoadState::Load;
    while (request != LoadState::None) {
        if (request == LoadState::Load)
            loadDirectory(next);
        else
            unloadWhileLoading();
        if (!self)
            return; // destroyed by an event processed during the load
        LoadState &state = loadStates()[this];
        request = state.deferred;
        next = state.deferredDirectory;
        state.deferred = LoadState::None;
    }
    loadStates().remove(this);
    enableChangeButton(_pluginDialog, true);
}

void PluginContainer::unloadWhileLoading()
{
    loadStates()[this].ownUnload = true;
    unloadPlugins();
    loadStates()[this].ownUnload = false;
}

void PluginContainer::loadDirectory(const QString &directory)
{
    Q_EMIT nodeContainerAboutToBeReset();

    // The unload's own announcements are not seen: to listeners, a reload is
    // the one reset announced around it.
    const bool wasBlocked = blockSignals(true);
    unloadWhileLoading();
    blockSignals(wasBlocked);

    _pluginPath = directory;

    // An empty path would mean the working directory: not what anyone
    // chooses as a plugin directory.
    if (directory.isEmpty() || !QFileInfo(directory).isDir()) {
        // Callers wrap loading in a wait cursor; the message must not show
        // under it.
        QApplication::restoreOverrideCursor();
        QMessageBox::critical(_parentWidget, QString(),
                              tr("Plugin directory '%1' not exist.").arg(directory),
                              QMessageBox::Ok);
        // No nodeContainerReset() here, on purpose: the tree stays empty and
        // listeners are not told that a new one is ready.
        return;
    }

    // The platform's order: the files are not sorted.
    QDirIterator it(directory, QStringList{QStringLiteral("*.so")}, QDir::Files,
                    QDirIterator::Subdirectories);
    const QPointer<PluginContainer> self(this);
    while (it.hasNext()) {
        it.next();
        QCoreApplication::processEvents();
        if (!self || !loadPlugin(it.fileInfo().absoluteFilePath()))
            return;
    }

    _rootNode->loadTreeFromList(_modules);
    Q_EMIT nodeContainerReset(_rootNode);
}

bool PluginContainer::loadPlugin(const QString &filePath)
{
    auto *loader = new QPluginLoader(filePath, this);
    // 9: every symbol resolved at load time, so a plugin with a missing
    // symbol is refused now rather than failing later; and the shared object
    // stays mapped after unloading, as objects it made may outlive it.
    loader->setLoadHints(QLibrary::ResolveAllSymbolsHint | QLibrary::PreventUnloadHint);
    _plugins.append(PluginEntry(loader, nullptr));

    if (!loader->load())
        return true;

    QObject *instance = loader->instance();
    auto *plugin = qobject_cast<Plugin *>(instance);
    QString refusal;
    if (!instance)
        refusal = tr("The plugin has no root object.");
    else if (!plugin)
        refusal = tr("The plugin does not implement the interface %1.")
                      .arg(QLatin1String(KVT_PLUGIN_IID));
    else if (!plugin->isValid())
        refusal = QStringList{tr("The plugin cannot work on this system."),
                              plugin->property(unavailableReasonProperty).toString()}
                      .join(QLatin1Char(' '))
                      .trimmed();
    if (!refusal.isEmpty()) {
        loader->setProperty(refusalProperty, refusal);
        loader->unload();
        return true;
    }

    _plugins.last().second = plugin;
    plugin->setParent(loader);

    // A copy: the plugin may change its list while events are processed.
    const QList<QObject *> objects = plugin->modules();
    const RelayedSignals &relayed = relayedSignals();
    bool contributed = false;
    const QPointer<PluginContainer> self(this);
    for (QObject *object : objects) {
        QCoreApplication::processEvents();
        if (!self)
            return false;
        auto *module = qobject_cast<Module *>(object);
        if (!module)
            continue;
        // contentElementWidgetChanged(int) and customContextMenuRequested(QPoint)
        // of the module to the container's signals of the same names.
        connect(module, relayed.moduleContent, this, relayed.containerContent);
        connect(module, relayed.moduleMenu, this, relayed.containerMenu);
        _modules.append(module);
        contributed = true;
    }
    if (contributed)
        _availableOperationsClass |= plugin->availableOperationsClass();
    return true;
}

void PluginContainer::unloadPlugins()
{
    const auto state = loadStates().find(this);
    if (state != loadStates().end() && !state->ownUnload) {
        // The load under way walks the plugin list: the unload waits for it.
        state->deferred = LoadState::Unload;
        qCWarning(KVT_PLUGIN, "PluginContainer::unloadPlugins() called during a load: deferred until that load ends");
        return;
    }
    Q_EMIT nodeContainerAboutToBeReset();

    _availableOperationsClass = 0;
    _pluginPath.clear();
    _modules.clear();
    // Detached, not deleted: the modules belong to their plugins.
    _rootNode->clear();

    const QList<PluginEntry> entries = _plugins;
    _plugins.clear();
    for (const PluginEntry &entry : entries) {
        if (entry.second)
            entry.first->unload();
        // Takes the plugin object, a child of its loader, and the plugin's
        // modules with it.
        delete entry.first;
    }

    Q_EMIT nodeContainerReset(_rootNode);
}

QString PluginContainer::pluginError(int index) const
{
    if (index < 0 || index >= _plugins.size())
        return QString();
    const PluginEntry &entry = _plugins.at(index);
    if (entry.second)
        return QString();
    const QString refusal = entry.first->property(refusalProperty).toString();
    if (!refusal.isEmpty())
        return refusal;
    return entry.first->errorString();
}

void PluginContainer::showPluginDialog() const
{
    _pluginDialog->show();
    _pluginDialog->raise();
    _pluginDialog->activateWindow();
}
