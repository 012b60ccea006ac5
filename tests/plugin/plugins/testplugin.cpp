// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// One plugin source, built several times with different definitions:
//   TEST_PLUGIN_NAME     display name
//   TEST_PLUGIN_MASK     available operation classes
//   TEST_PLUGIN_VALID    what isValid() answers
//   TEST_PLUGIN_MODULES  "alpha,*,alpha/alpha-child": a module per entry,
//                        "parent/id" a module one level below parent,
//                        "*" an object in modules() that is not a module

#include <kvt-common/acceptormodule.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/plugin.h>

// A plain module with the force reread mode, directly below the module root.
struct TopModule : Module {
    TopModule(const QString &id, QObject *parent) : Module(id, parent, true)
    {
        _expectedDepth = 1;
        _moduleData->insert(QStringLiteral("description"), id + QStringLiteral(" module"));
    }
};

class TestPlugin : public Plugin
{
    Q_OBJECT
    Q_PLUGIN_METADATA(IID "brel-admin-kvt/0.0")
    Q_INTERFACES(Plugin)

public:
    TestPlugin()
    {
        _name = QStringLiteral(TEST_PLUGIN_NAME);
        _description = QStringLiteral("The plugin ") + _name;
        _availableOperationsClass = TEST_PLUGIN_MASK;
        if (!TEST_PLUGIN_VALID)
            setProperty("unavailableReason", QStringLiteral("It needs a host it does not have."));
        for (const QString &entry : QStringLiteral(TEST_PLUGIN_MODULES).split(QLatin1Char(','))) {
            const QString parentId = entry.section(QLatin1Char('/'), 0, -2);
            const QString id = entry.section(QLatin1Char('/'), -1);
            if (entry == QLatin1String("*"))
                _modules.append(new QObject(this));
            else if (parentId.isEmpty())
                _modules.append(new TopModule(id, this));
            else
                _modules.append(new AcceptorModule(id, 2, parentId, id + QStringLiteral(" module"), this));
        }
    }

    bool isValid() const override { return TEST_PLUGIN_VALID; }
};

#include "testplugin.moc"
