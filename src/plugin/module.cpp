// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "module.h"

#include "containerelement.h"
#include "element.h"
#include "elementdata.h"
#include "elementwidget.h"
#include "vieweditelementwidget.h"
#include "module_p.h"

#include <QLoggingCategory>
#include <QMutex>
#include <QMutexLocker>
#include <QPointer>
#include <QSet>
#include <QSettings>
#include <QVector>

#include <dlfcn.h>
#include <unistd.h>

Q_LOGGING_CATEGORY(lcModule, "kvt.module", QtInfoMsg)

namespace {

const QString nameKey = QStringLiteral("name");
const QString paranoidKey = QStringLiteral("paranoid");
const QString descriptionKey = QStringLiteral("description");
const QString administratorKey = QStringLiteral("administrator");
const QString macAdministratorKey = QStringLiteral("macAdministrator");

// ---- modules being destroyed -------------------------------------------------

QMutex dyingMutex;
QSet<const Module *> dyingModules;

// ---- host integrity query ----------------------------------------------------

using MaxIntegrityQuery = bool (*)();

const char hostLibraryName[] = "libtarnhelper.so.1";
// MICDetect::isCurrentProcessHasMaxMIC(): a static member of class MICDetect
// and a free function of namespace MICDetect have this same symbol.
const char maxIntegritySymbol[] = "_ZN9MICDetect25isCurrentProcessHasMaxMICEv";

// On a host without integrity levels there is nothing above an
// administrator process: it runs at the highest level there is.
bool withoutIntegrityLevels()
{
    return true;
}

MaxIntegrityQuery resolveMaxIntegrityQuery()
{
    // Loaded at run time, never linked: most hosts do not have the library.
    void *handle = dlopen(hostLibraryName, RTLD_NOW | RTLD_LOCAL);
    if (!handle) {
        qCInfo(lcModule, "%s is not available (%s); the host has no integrity levels",
               hostLibraryName, dlerror());
        return withoutIntegrityLevels;
    }
    void *symbol = dlsym(handle, maxIntegritySymbol);
    if (!symbol) {
        qCWarning(lcModule, "%s has no MICDetect::isCurrentProcessHasMaxMIC(); "
                            "the host is taken to have no integrity levels",
                  hostLibraryName);
        dlclose(handle);
        return withoutIntegrityLevels;
    }
    // The handle stays open for the life of the process: the function is
    // called again at every check.
    return reinterpret_cast<MaxIntegrityQuery>(symbol);
}

bool hasMaxIntegrityLevel()
{
    static const MaxIntegrityQuery query = resolveMaxIntegrityQuery();
    try {
        return query();
    } catch (...) {
        // A host library that cannot answer grants nothing.
        qCWarning(lcModule, "the host integrity query failed");
        return false;
    }
}

bool isTrueBool(const QVariant &value)
{
    return value.isValid() && value.userType() == QMetaType::Bool && value.toBool();
}

} // namespace

void ModulePrivate::markDying(const Module *module)
{
    QMutexLocker locker(&dyingMutex);
    dyingModules.insert(module);
}

void ModulePrivate::markAlive(const Module *module)
{
    QMutexLocker locker(&dyingMutex);
    dyingModules.remove(module);
}

bool ModulePrivate::isDying(const Module *module)
{
    QMutexLocker locker(&dyingMutex);
    return dyingModules.contains(module);
}

Module::Module(const QString &name, QObject *parent, bool paranoid)
    : TreeNode(parent)
    , _moduleData(new ElementData)
{
    ModulePrivate::markAlive(this);
    setId(name);
    _moduleData->insert(nameKey, name);
    _moduleData->insert(paranoidKey, paranoid);
    // Stored settings override the defaults given above.
    loadSettings();
}

Module::~Module()
{
    ModulePrivate::markDying(this);
    saveSettings();
    // The widgets go first: they still refer to the module and may read its
    // data while they are destroyed.
    const QList<ElementWidget *> widgets = _elementWidgets.values();
    _elementWidgets.clear();
    qDeleteAll(widgets);
    delete _moduleData;
    _moduleData = nullptr;
    _elementActionsMap.clear();
    _elementNodes.clear();
}

void Module::performOperation(ContextOperation *context, OperationType type, ElementData *data,
                              int flags)
{
    // Guarded: a child module's answer may change or shrink this list.
    QVector<QPointer<Module>> modules;
    for (TreeNode *node : qAsConst(_childNodes)) {
        if (auto *module = qobject_cast<Module *>(node))
            modules.append(module);
    }
    for (const QPointer<Module> &module : qAsConst(modules)) {
        if (module)
            module->performOperation(context, type, data, flags);
    }
}

QString Module::paranoidSettingsKey() const
{
    // No separator between the group and "paranoid", on purpose: existing
    // settings are stored that way (module/usersparanoid).
    return QStringLiteral("%1%2").arg(QStringLiteral("module/%1").arg(id()), paranoidKey);
}

void Module::loadSettings()
{
    if (!_moduleData || !_moduleData->contains(paranoidKey))
        return;
    QSettings settings;
    const QVariant current = _moduleData->value(paranoidKey);
    _moduleData->insert(paranoidKey, settings.value(paranoidSettingsKey(), current).toBool());
}

void Module::saveSettings() const
{
    if (!_moduleData || !_moduleData->contains(paranoidKey))
        return;
    QSettings settings;
    settings.setValue(paranoidSettingsKey(), _moduleData->value(paranoidKey).toBool());
}

QVariant Module::data(int column, int role) const
{
    switch (column) {
    case 0:
        if (role == Qt::DisplayRole || role == Qt::ToolTipRole)
            return id();
        break;
    case 1:
        if (role == Qt::ToolTipRole)
            return tr("Force reread mode");
        // A boolean rather than a check state number: views treat both
        // alike, and plugins compare it as a boolean.
        if (role == Qt::CheckStateRole && _moduleData && _moduleData->contains(paranoidKey))
            return _moduleData->value(paranoidKey).toBool();
        break;
    case 2:
        if ((role == Qt::DisplayRole || role == Qt::ToolTipRole) && _moduleData
            && _moduleData->contains(descriptionKey))
            return _moduleData->value(descriptionKey);
        break;
    default:
        break;
    }
    return QVariant();
}

bool Module::setData(int column, const QVariant &value, int role)
{
    if (column != 1 || role != Qt::CheckStateRole)
        return false;
    if (!_moduleData || !_moduleData->contains(paranoidKey))
        return false;
    const bool checked = value.toInt() == Qt::Checked;
    if (_moduleData->value(paranoidKey).toBool() == checked)
        return false;
    _moduleData->insert(paranoidKey, checked);
    return true;
}

Qt::ItemFlags Module::flags(int column) const
{
    Qt::ItemFlags result = TreeNode::flags(column);
    if (column == 1 && _moduleData && _moduleData->contains(paranoidKey))
        result |= Qt::ItemIsUserCheckable;
    return result;
}

bool Module::canFetchMore() const
{
    return false;
}

void Module::fetchMore()
{
}

QVariant Module::getData(const QString &key) const
{
    if (!_moduleData)
        return QVariant();
    return _moduleData->value(key);
}

QVariant Module::getDataHierarchy(const QString &key) const
{
    for (const TreeNode *node = this; node; node = node->parentNode()) {
        const auto *module = qobject_cast<const Module *>(node);
        if (!module)
            break;
        if (module->_moduleData && module->_moduleData->contains(key))
            return module->_moduleData->value(key);
    }
    return QVariant();
}

Element *Module::element(const QString &name) const
{
    for (TreeNode *node : _elementNodes) {
        if (node && node->id() == name)
            return qobject_cast<Element *>(node);
    }
    return nullptr;
}

QList<QAction *> Module::elementActions(const QString &type) const
{
    return _elementActionsMap.value(type);
}

ElementWidget *Module::elementWidget(const QString &type) const
{
    return _elementWidgets.value(type, nullptr);
}

void Module::insertElementWidget(ElementWidget *widget)
{
    if (!widget)
        return;
    const QString type = widget->elementType();
    if (type == ContextOperation::undefinedElementType || _elementWidgets.contains(type)) {
        delete widget;
        return;
    }
    _elementWidgets.insert(type, widget);
    // A widget deleted by someone else (its parent window) is forgotten, so
    // the module never deletes it a second time.
    connect(widget, &QObject::destroyed, this, [this, type, widget] {
        const auto it = _elementWidgets.find(type);
        if (it != _elementWidgets.end() && it.value() == widget)
            _elementWidgets.erase(it);
    });
}

void Module::connectElementWidgets()
{
    for (ElementWidget *widget : qAsConst(_elementWidgets)) {
        if (qobject_cast<ViewEditElementWidget *>(widget)) {
            connect(widget, SIGNAL(contentChanged( int )), this,
                    SIGNAL(contentElementWidgetChanged( int )), Qt::UniqueConnection);
        }
        // Checked by class name: the list widgets are built on top of this
        // library's core, which does not depend on them.
        if (widget->inherits("ListElementWidget")) {
            connect(widget, SIGNAL(customContextMenuRequested( QPoint )), this,
                    SIGNAL(customContextMenuRequested( QPoint )), Qt::UniqueConnection);
        }
    }
}

void Module::resetConteinerElement()
{
    // Guarded: clearing one container may destroy nodes listed after it.
    QVector<QPointer<ContainerElement>> containers;
    for (TreeNode *node : qAsConst(_elementNodes)) {
        if (auto *container = qobject_cast<ContainerElement *>(node))
            containers.append(container);
    }
    for (const QPointer<ContainerElement> &container : qAsConst(containers)) {
        if (!container)
            continue;
        container->clearDelete();
        container->resetRequireLoad();
    }
}

bool Module::defaultTrue(const Module &)
{
    return true;
}

bool Module::isAdministrator(const Module &)
{
    // Any other user is no administrator, whatever the host would say; the
    // host library is not even loaded for it.
    if (geteuid() != 0)
        return false;
    return hasMaxIntegrityLevel();
}

bool Module::isAdministratorHierarchy(const Module &module)
{
    return isTrueBool(module.getDataHierarchy(administratorKey));
}

bool Module::isMacAdministratorHierarchy(const Module &module)
{
    return isTrueBool(module.getDataHierarchy(macAdministratorKey));
}
