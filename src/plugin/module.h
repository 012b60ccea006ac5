#ifndef KVT_MODULE_H
#define KVT_MODULE_H

#include "operationtype.h"
#include "treenode.h"

#include <QList>
#include <QMap>
#include <QString>
#include <QVariant>

class ContextOperation;
class Element;
class ElementData;
class ElementWidget;
class QAction;
class QPoint;

/*!
 * One administrable area offered by a plugin: a node of the module tree that
 * holds the module's elements, the widgets that show them (one per element
 * type), a small record of module data and the settings that survive
 * between runs.
 *
 * Every operation performed on one of the module's elements or element
 * widgets reaches the module through performOperation(); a plugin's module
 * overrides it and, as a rule, starts a task there.
 *
 * The module keeps one setting, the force reread mode ("paranoid"). It is
 * read when the module is made and written when it is destroyed. Both happen
 * in Module's own constructor and destructor, so they always run Module's
 * loadSettings() and saveSettings(); a plugin that overrides them calls its
 * versions itself.
 *
 * The static rights checks are rights predicates for elements and widgets
 * (see ContextOperation).
 */
class KVTCOMMON_EXPORT Module : public TreeNode
{
    Q_OBJECT

public:
    Module(const QString &name, QObject *parent = nullptr, bool paranoid = false);
    ~Module() override;

    // Virtual interface added to TreeNode's; the order of declaration is
    // part of the binary interface that plugins are built against.
    /*!
     * Every operation on the module's elements and element widgets arrives
     * here. The record \a data is new and handed over with
     * CreateOperation (a create-role ViewEditElementWidget sends its
     * exportElementData(), with the widget as \a context and no element:
     * the widget is shown with setElement(nullptr, CreateElementRole)),
     * with UpdateOperation (applyContentChanges()) and with
     * ReadContentOperation after a creation in force reread mode
     * (CreateTask); the module gives it to the task it starts, or deletes
     * it. With ChangeDisplayOperation the record belongs to the caller.
     * The base hands the call on to the child modules.
     */
    virtual void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                                  int flags);
    virtual void loadSettings();
    virtual void saveSettings() const;

    QVariant data(int column, int role) const override;
    bool setData(int column, const QVariant &value, int role) override;
    Qt::ItemFlags flags(int column) const override;
    bool canFetchMore() const override;
    void fetchMore() override;

    ElementData *moduleData() const { return _moduleData; }
    QList<TreeNode *> elementNodes() const { return _elementNodes; }

    /*! The value of \a key in the module data; invalid when absent. */
    QVariant getData(const QString &key) const;
    /*! The value of \a key in this module's data or, failing that, in the
     *  nearest ancestor module that holds the key; invalid when none does. */
    QVariant getDataHierarchy(const QString &key) const;

    /*! The first element node whose id is \a name, or null. */
    Element *element(const QString &name) const;
    QList<QAction *> elementActions(const QString &type) const;
    ElementWidget *elementWidget(const QString &type) const;

    /*!
     * Keeps \a widget as the widget for its element type, and owns it from
     * now on. A widget whose type is undefined, or whose type already has a
     * widget, is deleted at once. A null widget is ignored.
     */
    void insertElementWidget(ElementWidget *widget);
    /*!
     * Relays the contentChanged() of every stored ViewEditElementWidget as
     * contentElementWidgetChanged(), and the context menu requests of every
     * stored list widget as customContextMenuRequested(). Calling it again
     * adds no second connection.
     */
    void connectElementWidgets();

    /*! Clears every container element of the module, destroying its
     *  children, and marks it to be read again. (The name is kept as plugins
     *  know it.) */
    void resetConteinerElement();

    /*! The settings key of the force reread mode, "module/<id>paranoid". */
    QString paranoidSettingsKey() const;

    static bool defaultTrue(const Module &module);
    static bool isAdministrator(const Module &module);
    static bool isAdministratorHierarchy(const Module &module);
    static bool isMacAdministratorHierarchy(const Module &module);

Q_SIGNALS:
    void contentElementWidgetChanged(int state);
    void customContextMenuRequested(const QPoint &pos);

protected:
    ElementData *_moduleData;
    QList<TreeNode *> _elementNodes;
    QMap<QString, ElementWidget *> _elementWidgets;
    QMap<QString, QList<QAction *>> _elementActionsMap;
};

#endif // KVT_MODULE_H
