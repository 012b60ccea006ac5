#ifndef KVT_ELEMENT_H
#define KVT_ELEMENT_H

#include "contextoperation.h"
#include "elementwidgetrole.h"
#include "treenode.h"

#include <QIcon>
#include <QList>
#include <QStringList>

class ElementWidget;
class QAction;

/*!
 * One managed object of a module: a user, a service, a configuration entry,
 * a group of such objects. An element is a node of its module's element tree
 * and a ContextOperation at once. It does almost no work itself: it tells
 * which operations it offers and hands those it accepts to its module,
 * which as a rule starts a background task.
 *
 * Plugins derive from one of the element kinds (ContainerElement,
 * OrdinaryElement, ...) rather than from this class.
 *
 * Every element inserted below an element (or an ElementRootTreeNode) has
 * InsertedOperation performed by its module right after the insertion, and
 * every element removed has RemovedOperation performed right after the
 * removal, including the removals made by destruction.
 *
 * An element laid out by TreeNode::loadTreeFromList() (expected depth other
 * than -1) is persistent: it keeps its title and id, cannot be deleted and
 * has no creation widget.
 */
class KVTCOMMON_EXPORT Element : public TreeNode, public ContextOperation
{
    Q_OBJECT

public:
    Element(Module &module, RightsPredicate rights);
    ~Element() override;

    void insert(int position, const QList<TreeNode *> &nodes) override;
    void removeAt(int position, int count) override;
    int columnCount() const override;
    QVariant data(int column, int role) const override;
    bool canFetchMore() const override;
    void fetchMore() override;

    // Virtual interface added to TreeNode's; the order of declaration is
    // part of the binary interface that plugins are built against.
    /*!
     * The module's widget for the element's type (null for the create role
     * of a persistent element). The widget container shows a create-role
     * widget without an element; a container element under which new
     * elements are created overrides this to tell its widget where they go
     * (CreateTask's afterRun() asks the container for its create-role
     * widget too).
     */
    virtual ElementWidget *elementWidget(ElementWidgetRole role);
    virtual int displayChildrenVariant() const;
    virtual QStringList displayChildrenVariants() const;
    virtual QString questionForRemove() const;

    using TreeNode::insert;

    const QString &title() const { return _title; }
    /*! Sets the title and the id "<element type>_<title>"; ignored for a
     *  persistent element. */
    void setTitle(const QString &title);

    ElementData *elementData() const { return _elementData; }
    /*! Replaces the record without deleting the previous one: the caller
     *  takes care of it. The element deletes the record it holds when it is
     *  destroyed. */
    void setElementData(ElementData *data) { _elementData = data; }

    /*! The element's own group type or, while that is undefined, the nearest
     *  ancestor element's defined one. */
    QString groupElementType() const;
    bool isPersistent() const;
    bool requireLoad() const { return _requireLoad; }

    QList<QAction *> elementActions() const;

    static const QIcon &defaultIcon();
    static const QString &defaultQuestionForRemove();

protected:
    QString _groupElementType;
    ElementData *_elementData;
    bool _requireLoad;
    QString _title;
    int _displayChildrenVariant;
};

#endif // KVT_ELEMENT_H
