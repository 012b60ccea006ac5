// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_PLUGINDIALOG_H
#define KVT_PLUGINDIALOG_H

#include "kvtcommon_export.h"

#include <QDialog>

class PluginContainer;

namespace Ui {
class PluginDialog;
}

/*!
 * The window listing the plugin files a PluginContainer tried (with the
 * modules of each accepted plugin) and the module tree, in two tabs. The
 * plugin directory can be changed from here, which reloads the container.
 *
 * The dialog's geometry is kept in the application settings.
 */
class KVTCOMMON_EXPORT PluginDialog : public QDialog
{
    Q_OBJECT

public:
    //! Creates the dialog for \a container and restores its geometry. The container is not owned.
    explicit PluginDialog(PluginContainer *container, QWidget *parent = nullptr);
    //! Saves the geometry.
    ~PluginDialog() override;

    //! Restores the geometry from "pluginDialog/pluginDialogGeometry" when stored.
    void loadSettings();
    //! Stores the geometry under "pluginDialog/pluginDialogGeometry".
    void saveSettings() const;

public Q_SLOTS:
    /*! Asks for another plugin directory and, when one other than the
     *  current one is chosen, loads the plugins from it. */
    void changePath();

protected:
    //! Shows the container's current plugin directory.
    void showEvent(QShowEvent *event) override;

private Q_SLOTS:
    void forgetContainer();

private:
    void showPath();

    Ui::PluginDialog *_ui;
    PluginContainer *_pluginContainer;
};

#endif // KVT_PLUGINDIALOG_H
