// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "plugindialog.h"
#include "ui_plugindialog.h"

#include "plugincontainer.h"
#include "plugincontainer_p.h"
#include "pluginmodel.h"
#include "treenodemodel.h"

#include <QDir>
#include <QFileDialog>
#include <QHeaderView>
#include <QSettings>

namespace {

const char geometryKey[] = "pluginDialog/pluginDialogGeometry";

} // namespace

PluginDialog::PluginDialog(PluginContainer *container, QWidget *parent)
    : QDialog(parent)
    , _ui(new Ui::PluginDialog)
    , _pluginContainer(container)
{
    _ui->setupUi(this);
    _ui->_pluginTtreeView->header()->setSectionResizeMode(QHeaderView::ResizeToContents);
    _ui->_moduleTreeView->header()->setSectionResizeMode(QHeaderView::ResizeToContents);
    if (container) {
        _ui->_pluginTtreeView->setModel(container->pluginModel());
        _ui->_moduleTreeView->setModel(container->treeNodeModel());
        // A dialog kept by a parent widget can outlive its container.
        connect(container, SIGNAL(destroyed()), this, SLOT(forgetContainer()));
    } else {
        forgetContainer();
    }
    loadSettings();
}

PluginDialog::~PluginDialog()
{
    saveSettings();
    delete _ui;
}

void PluginDialog::loadSettings()
{
    const QVariant geometry = QSettings().value(QLatin1String(geometryKey));
    if (geometry.isValid())
        restoreGeometry(geometry.toByteArray());
}

void PluginDialog::saveSettings() const
{
    QSettings().setValue(QLatin1String(geometryKey), saveGeometry());
}

void PluginDialog::changePath()
{
    // A load processes events: no second one starts from here meanwhile.
    if (!_pluginContainer || KvtPluginLoading::isLoading(_pluginContainer))
        return;
    const QString current = _pluginContainer->pluginPath();
    const QString directory = QFileDialog::getExistingDirectory(
        this, tr("Plugin directory"), current, QFileDialog::ShowDirsOnly);
    // The container may have gone while the file dialog was open.
    if (directory.isEmpty() || !_pluginContainer || KvtPluginLoading::isLoading(_pluginContainer))
        return;
    // "/usr/lib/x/" and "/usr/lib/x" are one directory: no reload for it.
    if (!current.isEmpty() && QDir::cleanPath(directory) == QDir::cleanPath(current))
        return;
    _pluginContainer->loadPlugins(directory);
    showPath();
}

void PluginDialog::showEvent(QShowEvent *event)
{
    showPath();
    QDialog::showEvent(event);
}

void PluginDialog::forgetContainer()
{
    _pluginContainer = nullptr;
    _ui->_pathLineEdit->clear();
    _ui->_pathLineEdit->setToolTip(QString());
    _ui->_changePushButton->setEnabled(false);
}

void PluginDialog::showPath()
{
    const QString path = _pluginContainer ? _pluginContainer->pluginPath() : QString();
    _ui->_pathLineEdit->setText(path);
    _ui->_pathLineEdit->setToolTip(path);
}
