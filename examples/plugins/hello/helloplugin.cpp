// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// hello: the smallest plugin worth copying.
//
// A plugin is a shared object whose root object derives from Plugin. The
// host's PluginContainer loads it, asks isValid(), and hangs the Module
// objects listed in modules() into its module tree. Each module lists the
// elements it manages in _elementNodes; the host's ElementContainer gathers
// them into one element tree.
//
// Build it as a MODULE library linked to KvtCommon::KvtCommon (see
// CMakeLists.txt beside this file) and put the .so file into the host's
// plugin directory.

#include <kvt-common/elementdata.h>
#include <kvt-common/module.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/plugin.h>

#include <QDebug>

namespace {

// One managed object: a greeting. A real plugin's element stands for a user,
// a service, a configuration entry...
class GreetingElement : public OrdinaryElement
{
    Q_OBJECT

public:
    GreetingElement(Module &module, const QString &title, const QString &text)
        // Module::defaultTrue: anyone may edit greetings. An administration
        // plugin passes Module::isAdministrator or one of its kin.
        : OrdinaryElement(module, Module::defaultTrue)
    {
        // The element type chooses the widget and the actions the module
        // offers for the element.
        _elementType = QStringLiteral("greeting");
        // Title and id ("greeting_<title>"); set before the layout below,
        // as a laid-out element keeps its title.
        setTitle(title);
        // Laid out directly below the element root. Elements that hang
        // below another element give depth 2 and that element's id:
        //     _expectedDepth = 2; _expectedParentId = "greeting_morning";
        _expectedDepth = 1;
        // The element's record, owned and deleted by the element.
        _elementData = new ElementData;
        _elementData->insert(QStringLiteral("name"), title);
        _elementData->insert(QStringLiteral("text"), text);
    }

    // Every element kind leaves the tool tip to the plugin.
    QString toolTipText() const override
    {
        return _elementData->value(QStringLiteral("text")).toString();
    }
};

// One administrable area: the module tree shows it as a row, and every
// operation on its elements arrives in performOperation().
class HelloModule : public Module
{
    Q_OBJECT

public:
    explicit HelloModule(QObject *parent)
        // The id "hello", and the force reread mode off by default (the user
        // can tick it in the module tree; it is kept in the settings).
        : Module(QStringLiteral("hello"), parent, false)
    {
        // Directly below the module root. A module extending another one
        // gives depth 2 and that module's id, or derives from AcceptorModule.
        _expectedDepth = 1;
        _moduleData->insert(QStringLiteral("description"), tr("Greetings of this host"));
        _elementNodes << new GreetingElement(*this, QStringLiteral("morning"),
                                             tr("Good morning!"))
                      << new GreetingElement(*this, QStringLiteral("evening"),
                                             tr("Good evening!"));
    }

    ~HelloModule() override
    {
        // Out of the element tree first, while the elements are whole: the
        // views told of the removal may still ask them for their data.
        for (TreeNode *node : qAsConst(_elementNodes))
            node->reset();
        qDeleteAll(_elementNodes);
    }

    void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                          int flags) override
    {
        // A real module starts a task here: it builds an AbstractTask with a
        // copy of the element's data and hands it to
        // TaskObserver::instance()->performTask(task), so that the work runs
        // on a worker thread. This one only says what it was asked.
        if (Element *element = context ? context->elementContext() : nullptr)
            qInfo() << "hello:" << element->title() << "asked for operation" << int(type);
        // The base hands the operation on to child modules.
        Module::performOperation(context, type, data, flags);
    }
};

} // namespace

// The root object. Q_PLUGIN_METADATA names the plugin interface, and the
// constructor fills in what the plugin list shows.
class HelloPlugin : public Plugin
{
    Q_OBJECT
    Q_PLUGIN_METADATA(IID KVT_PLUGIN_IID)
    Q_INTERFACES(Plugin)

public:
    HelloPlugin()
    {
        _name = tr("Hello");
        _description = tr("An example plugin with one module of two greetings");
        // The classes of operation the modules offer, as the host tool
        // numbers them.
        _availableOperationsClass = 1;
        // Children of the plugin: they go when the plugin is unloaded.
        _modules << new HelloModule(this);
    }

    // False when the plugin cannot work on this host (a program or a
    // service it needs is missing): the container unloads it then.
    bool isValid() const override { return true; }
};

#include "helloplugin.moc"
