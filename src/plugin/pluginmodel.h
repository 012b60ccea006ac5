// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PLUGINMODEL_H
#define KVT_PLUGINMODEL_H

#include "kvtcommon_export.h"

#include <QAbstractItemModel>

class PluginContainer;

/*!
 * The plugin files of a PluginContainer and their modules, in two levels
 * and two columns: every file tried on top (name and description of an
 * accepted plugin, or the file name and why it was refused), the modules of
 * each accepted plugin below it (id and description).
 *
 * Every load or unload of the container is one model reset.
 *
 * The internal pointer of an index is its parent object: null for a file,
 * the Plugin for a module.
 */
class KVTCOMMON_EXPORT PluginModel : public QAbstractItemModel
{
    Q_OBJECT

public:
    //! Creates the model of \a container (not owned), following its loads and unloads.
    explicit PluginModel(PluginContainer *container, QObject *parent = nullptr);
    //! Destroys the model.
    ~PluginModel() override;

    //! The index of \a row and \a column under \a parent; invalid when out of range.
    QModelIndex index(int row, int column, const QModelIndex &parent = QModelIndex()) const override;
    //! The file row of a module row; invalid for a file row.
    QModelIndex parent(const QModelIndex &index) const override;
    //! Every file tried at the top; the modules of an accepted plugin below it.
    int rowCount(const QModelIndex &parent = QModelIndex()) const override;
    //! Two columns, "Name" and "Description".
    int columnCount(const QModelIndex &parent = QModelIndex()) const override;
    /*!
     * Name (with a "task-complete" or "task-reject" icon and the file name as tool
     * tip) and description of a file, or id and description of a module. A refused
     * file shows its file name and why it was refused.
     */
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    //! The translated "Name" and "Description".
    QVariant headerData(int section, Qt::Orientation orientation,
                        int role = Qt::DisplayRole) const override;

    /*! The object of a row: the accepted Plugin or, for a refused file, its
     *  QPluginLoader; a module row's object from the plugin's modules();
     *  null for an invalid index. */
    QObject *indexToObject(const QModelIndex &index) const;
    /*! The index (column 0) of a top-level row's object, a Plugin or a
     *  loader; invalid for anything else. */
    QModelIndex ObjectToIndex(QObject *object) const;

public Q_SLOTS:
    //! Begins the model reset of a load or unload.
    void pluginContainerAboutToBeReset();
    //! Ends the model reset of a load or unload.
    void pluginContainerReset();

private:
    int entryOf(const QObject *object) const;

    PluginContainer *_pluginContainer;
};

#endif // KVT_PLUGINMODEL_H
