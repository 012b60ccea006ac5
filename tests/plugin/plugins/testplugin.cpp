// One plugin source, built several times with different definitions:
//   TEST_PLUGIN_NAME     display name
//   TEST_PLUGIN_MASK     available operation classes
//   TEST_PLUGIN_VALID    what isValid() answers
//   TEST_PLUGIN_MODULES  "alpha,*,alpha/alpha-child": a module per entry,
//                        "parent/id" a module one level below parent,
//                        "*" an object in modules() that is not a module
// Every top-level module holds one element "<id>-item".

#include <kvt-common/acceptormodule.h>
#include <kvt-common/elementdata.h>
#include <kvt-common/module.h>
#include <kvt-common/ordinaryelement.h>
#include <kvt-common/plugin.h>

#include <QStringList>

namespace {

class ItemElement : public OrdinaryElement
{
    Q_OBJECT

public:
    ItemElement(Module &module, const QString &title)
        : OrdinaryElement(module, Module::defaultTrue)
    {
        _elementType = QStringLiteral("item");
        setTitle(title);
        // Directly below the element root; set after the title, which a
        // laid-out element no longer takes.
        _expectedDepth = 1;
    }

    QString toolTipText() const override { return title(); }
};

class ItemModule : public Module
{
    Q_OBJECT

public:
    ItemModule(const QString &id, QObject *parent)
        : Module(id, parent, true)
    {
        _expectedDepth = 1; // directly below the module root
        _moduleData->insert(QStringLiteral("description"), id + QStringLiteral(" module"));
        _elementNodes.append(new ItemElement(*this, id + QStringLiteral("-item")));
    }

    ~ItemModule() override
    {
        // Out of the element tree first, while the elements are whole:
        // whoever hears of the removal may still ask them for their data.
        for (TreeNode *node : qAsConst(_elementNodes))
            node->reset();
        qDeleteAll(_elementNodes);
    }
};

} // namespace

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
        const QStringList entries =
            QStringLiteral(TEST_PLUGIN_MODULES).split(QLatin1Char(','), Qt::SkipEmptyParts);
        for (const QString &entry : entries) {
            if (entry == QLatin1String("*")) {
                _modules.append(new QObject(this));
                continue;
            }
            const QString parentId = entry.section(QLatin1Char('/'), 0, -2);
            const QString id = entry.section(QLatin1Char('/'), -1);
            if (parentId.isEmpty())
                _modules.append(new ItemModule(id, this));
            else
                _modules.append(new AcceptorModule(id, 2, parentId, id + QStringLiteral(" module"),
                                                   this));
        }
    }

    bool isValid() const override { return TEST_PLUGIN_VALID; }
};

#include "testplugin.moc"
