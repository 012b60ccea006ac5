#ifndef KVT_PLUGINCONTAINER_H
#define KVT_PLUGINCONTAINER_H

#include "nodecontainer.h"

#include <QList>
#include <QPair>
#include <QString>
#include <QtGlobal>

class Plugin;
class PluginDialog;
class PluginModel;
class QPluginLoader;
class QPoint;
class QWidget;

/*!
 * Loads the plugins of a directory and hangs their modules into one tree
 * under a ModuleRootTreeNode, shown by the container's tree model.
 *
 * Every "*.so" file below the directory (subdirectories included) is tried.
 * A file is accepted when it loads, its root object answers the Plugin
 * interface and the plugin is valid on this host; the Module objects of an
 * accepted plugin are collected and hung by their expected depth and
 * expected parent id. Every file tried keeps an entry, accepted or not, so
 * the plugin model can list why a file was refused.
 *
 * A (re)load or an unload is announced as one reset:
 * nodeContainerAboutToBeReset() before anything changes and
 * nodeContainerReset() when the tree is complete.
 */
class KVTCOMMON_EXPORT PluginContainer : public NodeContainer
{
    Q_OBJECT

public:
    //! A file tried: its loader (owned) and the accepted plugin, or null.
    typedef QPair<QPluginLoader *, Plugin *> PluginEntry;

    explicit PluginContainer(QObject *parent = nullptr);
    ~PluginContainer() override;

    /*!
     * Unloads what is loaded and loads every plugin below \a directory.
     * Pending interface events are processed between files and between
     * modules, so the window stays responsive. A load or unload asked for by
     * such an event waits: it runs when the current load has ended (of
     * several, the last one asked for), and a warning is logged.
     *
     * A missing directory is reported in a message box and leaves the
     * container empty.
     */
    void loadPlugins(const QString &directory);
    /*! Detaches and destroys every plugin and module; the tree is empty
     *  afterwards. Asked for during a load, it waits until the load ends. */
    void unloadPlugins();

    /*! The union of the operation classes of the plugins that contributed
     *  at least one module. */
    quint64 availableOperationsClass() const { return _availableOperationsClass; }
    QString pluginPath() const { return _pluginPath; }
    QList<TreeNode *> modules() const { return _modules; }
    PluginModel *pluginModel() const { return _pluginModel; }

    /*! Every file tried by the last load, in the order tried. */
    const QList<PluginEntry> &plugins() const { return _plugins; }
    /*! Why the file of entry \a index was not accepted: the loader's error,
     *  or the reason a loaded plugin was refused. Empty for an accepted
     *  plugin or an index out of range. */
    QString pluginError(int index) const;

public Q_SLOTS:
    void showPluginDialog() const;

Q_SIGNALS:
    void contentElementWidgetChanged(int state);
    void customContextMenuRequested(const QPoint &pos);

protected:
    quint64 _availableOperationsClass;
    QWidget *_parentWidget;
    QString _pluginPath;
    QList<PluginEntry> _plugins;
    QList<TreeNode *> _modules;
    PluginModel *_pluginModel;
    PluginDialog *_pluginDialog;

private:
    void loadDirectory(const QString &directory);
    bool loadPlugin(const QString &filePath);
    void unloadWhileLoading();
};

#endif // KVT_PLUGINCONTAINER_H
