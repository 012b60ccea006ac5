// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    /*!
     * Creates the module \a name (its id and its module data "name"). \a paranoid
     * is the default of the force reread mode; the stored setting, read at once by
     * loadSettings(), overrides it. \a parent is normally the plugin, which owns
     * the module.
     */
    Module(const QString &name, QObject *parent = nullptr, bool paranoid = false);
    /*!
     * Saves the settings, deletes the stored element widgets, then releases the
     * module data. The elements in elementNodes() are not deleted here: a
     * module that owns them deletes them in its own destructor, after taking
     * them out of the tree (TreeNode::reset()) while they are still whole.
     */
    ~Module() override;

    // Virtual interface added to TreeNode's; the order of declaration is
    // part of the binary interface that plugins are built against.
    /*!
     * The one place where operations on the module's elements and element widgets
     * reach plugin code. \a context is the Element (ContextOperation::elementContext())
     * or the ElementWidget (ContextOperation::elementWidgetContext()) the operation
     * was performed on, \a type the operation, \a flags what the caller passed on
     * (0 from the library).
     *
     * A plugin overrides it and, as a rule, starts a task:
     * \code
     * void UsersModule::performOperation(ContextOperation *context, OperationType type,
     *                                    ElementData *data, int flags)
     * {
     *     Element *element = context->elementContext();
     *     switch (type) {
     *     case ReadPropertyOperation:
     *         TaskObserver::instance()->performTask(new ReadUserTask(element));
     *         break;
     *     case UpdateOperation:
     *         TaskObserver::instance()->performTask(new UpdateUserTask(element, data));
     *         break;
     *     case CreateOperation:
     *         TaskObserver::instance()->performTask(new CreateUserTask(element, data));
     *         break;
     *     default:
     *         break;
     *     }
     * }
     * \endcode
     *
     * \b Ownership \b of \a data. For CreateOperation and UpdateOperation, and
     * for the ReadContentOperation that CreateTask performs after a creation in
     * force reread mode, \a data is a new record that is handed over with the
     * call: the module owns it from then on and gives it to the task it starts
     * (which deletes it) or deletes it itself. A create-role ViewEditElementWidget
     * sends its exportElementData() with CreateOperation, with the widget as
     * \a context and no element (the widget is shown with
     * setElement(nullptr, CreateElementRole)). The library passes null for
     * InsertedOperation, RemovedOperation, ResetOperation, ReadPropertyOperation,
     * DeleteOperation and the content reads of an expansion. A record that comes
     * with any other operation (ChangeDisplayOperation, plugin operations) belongs
     * to the caller and is valid only during the call.
     *
     * Runs in the interface thread. The base passes the call on, unchanged, to
     * each child node that is a Module.
     */
    virtual void performOperation(ContextOperation *context, OperationType type, ElementData *data,
                                  int flags);
    /*!
     * Reads the force reread mode from the application's settings
     * (paranoidSettingsKey()) when the module data holds "paranoid". Called by the
     * constructor.
     */
    virtual void loadSettings();
    /*!
     * Writes the force reread mode when the module data holds "paranoid". Called by the destructor.
     */
    virtual void saveSettings() const;

    /*!
     * Column 0 the id, column 1 the force reread check box (a bool for
     * Qt::CheckStateRole), column 2 the "description" of the module data.
     */
    QVariant data(int column, int role) const override;
    /*!
     * Switches the force reread mode from the check box of column 1; true only when
     * the stored value changed. Saved when the module is destroyed.
     */
    bool setData(int column, const QVariant &value, int role) override;
    //! Column 1 is user-checkable when the module has a force reread mode.
    Qt::ItemFlags flags(int column) const override;
    //! False: modules have no lazily read children.
    bool canFetchMore() const override;
    //! Does nothing.
    void fetchMore() override;

    /*!
     * The module's record (owned): "name", "paranoid", "description",
     * "administrator", "macAdministrator" and any key of the plugin's own.
     */
    ElementData *moduleData() const { return _moduleData; }
    /*!
     * The module's element nodes, which ElementContainer hangs into the element
     * tree by their expected depth and expected parent id. The module fills
     * _elementNodes in its constructor; it owns the nodes it creates.
     */
    QList<TreeNode *> elementNodes() const { return _elementNodes; }

    /*! The value of \a key in the module data; invalid when absent. */
    QVariant getData(const QString &key) const;
    /*! The value of \a key in this module's data or, failing that, in the
     *  nearest ancestor module that holds the key; invalid when none does. */
    QVariant getDataHierarchy(const QString &key) const;

    /*! The first element node whose id is \a name, or null. */
    Element *element(const QString &name) const;
    //! The actions offered for elements of \a type; empty when none are stored.
    QList<QAction *> elementActions(const QString &type) const;
    //! The widget stored for elements of \a type, or null.
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

    //! Rights predicate that always allows.
    static bool defaultTrue(const Module &module);
    /*!
     * Rights predicate: the process runs as root (effective user id 0) and, on a
     * host with integrity levels, at the highest one.
     */
    static bool isAdministrator(const Module &module);
    /*!
     * Rights predicate: getDataHierarchy("administrator") is a bool and true (the
     * string "true" does not count).
     */
    static bool isAdministratorHierarchy(const Module &module);
    //! Rights predicate: getDataHierarchy("macAdministrator") is a bool and true.
    static bool isMacAdministratorHierarchy(const Module &module);

Q_SIGNALS:
    /*!
     * Relays ViewEditElementWidget::contentChanged() of the module's widgets (see
     * connectElementWidgets()); \a state is 0, 2 or 3.
     */
    void contentElementWidgetChanged(int state);
    //! Relays the context menu requests of the module's list widgets, \a pos in global coordinates.
    void customContextMenuRequested(const QPoint &pos);

protected:
    //! See moduleData(); owned.
    ElementData *_moduleData;
    //! See elementNodes(); filled by the plugin's constructor.
    QList<TreeNode *> _elementNodes;
    /*!
     * The widgets by element type; filled by insertElementWidget(), which makes the module their owner.
     */
    QMap<QString, ElementWidget *> _elementWidgets;
    //! The actions by element type, filled by the plugin; see elementActions().
    QMap<QString, QList<QAction *>> _elementActionsMap;
};

#endif // KVT_MODULE_H
