// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// What the documentation's snippets take for granted: the library's headers
// as a plugin or host includes them, and the GreetingElement of the example
// plugin, which the plugin snippet refers to.

#ifndef KVT_SNIPPETCONTEXT_H
#define KVT_SNIPPETCONTEXT_H

#include <kvt-common/confroottreenode.h>
#include <kvt-common/conftreenode.h>
#include <kvt-common/elementcontainer.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/elementtreeview.h>
#include <kvt-common/elementwidgetcontainer2.h>
#include <kvt-common/module.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/plugin.h>
#include <kvt-common/plugincontainer.h>
#include <kvt-common/readpropertyheavytask.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/thread.h>
#include <kvt-common/treenodemodel.h>

#include <QApplication>
#include <QFile>
#include <QThread>

class GreetingElement : public OrdinaryElement
{
    Q_OBJECT

public:
    GreetingElement(Module &module, const QString &title, const QString &text)
        : OrdinaryElement(module, Module::defaultTrue)
    {
        _elementType = QStringLiteral("greeting");
        setTitle(title);
        _expectedDepth = 1;
        _elementData = new ElementData;
        _elementData->insert(QStringLiteral("text"), text);
    }

    QString toolTipText() const override { return _elementData->value(QStringLiteral("text")).toString(); }
};

#endif // KVT_SNIPPETCONTEXT_H
