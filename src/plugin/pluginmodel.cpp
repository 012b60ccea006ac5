// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "pluginmodel.h"

#include "module.h"
#include "plugin.h"
#include "plugincontainer.h"
#include "kvticons_p.h"

#include <QIcon>
#include <QPluginLoader>
#include <QSet>

namespace {

// Models between the container's two reset signals. A load into a missing
// directory announces a reset it never completes; the next load must not
// open a second one inside it.
QSet<const PluginModel *> resettingModels;

} // namespace

PluginModel::PluginModel(PluginContainer *container, QObject *parent)
    : QAbstractItemModel(parent)
    , _pluginContainer(container)
{
    connect(container, SIGNAL(nodeContainerAboutToBeReset()),
            this, SLOT(pluginContainerAboutToBeReset()));
    connect(container, SIGNAL(nodeContainerReset( const TreeNode * )),
            this, SLOT(pluginContainerReset()));
}

PluginModel::~PluginModel()
{
    resettingModels.remove(this);
}

void PluginModel::pluginContainerAboutToBeReset()
{
    if (resettingModels.contains(this))
        return;
    resettingModels.insert(this);
    beginResetModel();
}

void PluginModel::pluginContainerReset()
{
    if (!resettingModels.remove(this))
        return;
    endResetModel();
}

int PluginModel::entryOf(const QObject *object) const
{
    if (!object)
        return -1;
    const QList<PluginContainer::PluginEntry> &entries = _pluginContainer->plugins();
    for (int i = 0; i < entries.size(); ++i) {
        if (entries.at(i).second == object || entries.at(i).first == object)
            return i;
    }
    return -1;
}

QObject *PluginModel::indexToObject(const QModelIndex &index) const
{
    if (!index.isValid() || index.model() != this)
        return nullptr;
    const QList<PluginContainer::PluginEntry> &entries = _pluginContainer->plugins();
    if (!index.internalPointer()) {
        if (index.row() >= entries.size())
            return nullptr;
        const PluginContainer::PluginEntry &entry = entries.at(index.row());
        if (entry.second)
            return entry.second;
        return entry.first;
    }
    // An index kept across a reload may name a plugin that is gone: it is
    // looked up among the entries before it is used.
    const int entry = entryOf(static_cast<QObject *>(index.internalPointer()));
    if (entry < 0 || !entries.at(entry).second)
        return nullptr;
    const QList<QObject *> &modules = entries.at(entry).second->modules();
    if (index.row() >= modules.size())
        return nullptr;
    return modules.at(index.row());
}

QModelIndex PluginModel::ObjectToIndex(QObject *object) const
{
    const int entry = entryOf(object);
    if (entry < 0)
        return QModelIndex();
    return createIndex(entry, 0, nullptr);
}

QModelIndex PluginModel::index(int row, int column, const QModelIndex &parent) const
{
    if (row < 0 || column < 0 || column >= columnCount(parent) || row >= rowCount(parent))
        return QModelIndex();
    if (!parent.isValid())
        return createIndex(row, column, nullptr);
    return createIndex(row, column, indexToObject(parent));
}

QModelIndex PluginModel::parent(const QModelIndex &index) const
{
    if (!index.isValid() || index.model() != this)
        return QModelIndex();
    return ObjectToIndex(static_cast<QObject *>(index.internalPointer()));
}

int PluginModel::rowCount(const QModelIndex &parent) const
{
    if (!parent.isValid())
        return _pluginContainer->plugins().size();
    // Modules hang off column 0 of an accepted plugin, and have no rows.
    if (parent.column() != 0 || parent.internalPointer())
        return 0;
    const auto *plugin = qobject_cast<const Plugin *>(indexToObject(parent));
    return plugin ? plugin->modules().size() : 0;
}

int PluginModel::columnCount(const QModelIndex &) const
{
    return 2;
}

QVariant PluginModel::data(const QModelIndex &index, int role) const
{
    QObject *object = indexToObject(index);
    if (!object)
        return QVariant();
    const bool textRole = role == Qt::DisplayRole || role == Qt::ToolTipRole;

    if (index.internalPointer()) {
        const auto *module = qobject_cast<const Module *>(object);
        if (!module || !textRole)
            return QVariant();
        if (index.column() == 0)
            return module->id();
        return module->data(2, Qt::DisplayRole);
    }

    const auto *plugin = qobject_cast<const Plugin *>(object);
    const QPluginLoader *loader = _pluginContainer->plugins().at(index.row()).first;
    if (index.column() == 0) {
        switch (role) {
        case Qt::DecorationRole:
            return kvtThemeIcon(plugin ? QStringLiteral("task-complete")
                                       : QStringLiteral("task-reject"));
        case Qt::DisplayRole:
            return plugin ? plugin->name() : loader->fileName();
        case Qt::ToolTipRole:
            return loader->fileName();
        default:
            return QVariant();
        }
    }
    if (!textRole)
        return QVariant();
    return plugin ? plugin->description() : _pluginContainer->pluginError(index.row());
}

QVariant PluginModel::headerData(int section, Qt::Orientation orientation, int role) const
{
    if (role != Qt::DisplayRole)
        return QVariant();
    if (orientation == Qt::Vertical)
        return section;
    switch (section) {
    case 0:
        return tr("Name");
    case 1:
        return tr("Description");
    default:
        return QVariant();
    }
}
