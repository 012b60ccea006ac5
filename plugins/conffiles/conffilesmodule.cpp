// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#include "conffilesmodule.h"

#include "conffileelements.h"
#include "conffiletasks.h"
#include "keywidget.h"

#include <kvt-common/elementdata.h>
#include <kvt-common/taskobserver.h>

#include <QFileInfo>
#include <QSettings>

const char ConfFilesModule::filesSettingsKey[] = "conffiles/files";

ConfFilesModule::ConfFilesModule(QObject *parent)
    : Module(QStringLiteral("conffiles"), parent, false)
{
    _expectedDepth = 1;
    QSettings settings;
    const QVariant stored = settings.value(QLatin1String(filesSettingsKey));
    if (stored.isValid()) {
        _files = stored.toStringList();
    } else {
        for (const QString &path : {QStringLiteral("/etc/adduser.conf"), QStringLiteral("/etc/login.defs")}) {
            if (QFileInfo::exists(path))
                _files.append(path);
        }
    }
    _files.removeAll(QString());
    _files.removeDuplicates();

    _moduleData->insert(QStringLiteral("description"),
                        _files.isEmpty() ? tr("Key/value configuration files (none set: list them under "
                                              "\"%1\" in the settings)").arg(QLatin1String(filesSettingsKey))
                                         : tr("Key/value configuration files: %1").arg(_files.join(QStringLiteral(", "))));
    for (const QString &path : qAsConst(_files))
        _elementNodes << new FileElement(*this, path);

    insertElementWidget(new KeyWidget(*this));
    connectElementWidgets();
}

ConfFilesModule::~ConfFilesModule()
{
    // Out of the element tree first, while the elements are whole: views
    // told of the removal may still ask them for their data. clearDelete()
    // destroys the key elements of a file.
    for (TreeNode *node : qAsConst(_elementNodes)) {
        node->clearDelete();
        node->reset();
    }
    qDeleteAll(_elementNodes);
}

void ConfFilesModule::performOperation(ContextOperation *context, OperationType type, ElementData *data,
                                       int flags)
{
    Element *element = context ? context->elementContext() : nullptr;
    AbstractTask *task = nullptr;
    switch (type) {
    case ReadContentOperation:
        if (auto *file = qobject_cast<FileElement *>(element))
            task = new ReadFileTask(file, data);
        else
            delete data;
        break;
    case ReadPropertyOperation:
        if (auto *key = qobject_cast<KeyElement *>(element))
            task = new ReadKeyTask(key);
        break;
    case UpdateOperation:
        if (auto *key = qobject_cast<KeyElement *>(element))
            task = new UpdateKeyTask(key, data);
        else
            delete data;
        break;
    case CreateOperation: {
        // From the key widget in the create role (the usual way), or from a
        // file or key element directly.
        FileElement *file = nullptr;
        if (auto *widget = qobject_cast<KeyWidget *>(context ? context->elementWidgetContext() : nullptr))
            file = widget->createTarget();
        else if (auto *key = qobject_cast<KeyElement *>(element))
            file = key->file();
        else
            file = qobject_cast<FileElement *>(element);
        if (file && data)
            task = new CreateKeyTask(file, data);
        else
            delete data;
        break;
    }
    case DeleteOperation:
        if (auto *key = qobject_cast<KeyElement *>(element); key && key->file())
            task = new DeleteKeyTask(key);
        break;
    default:
        Module::performOperation(context, type, data, flags);
        return;
    }
    if (task)
        TaskObserver::instance()->performTask(task);
}
