// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    /*!
     * Creates an element of \a module (not owned) whose editability \a rights
     * decides. Title and group type start empty and "Undefined"; no record.
     */
    Element(Module &module, RightsPredicate rights);
    /*!
     * Takes the element out of the tree (its module gets RemovedOperation),
     * detaches its children without deleting them, and deletes its record.
     */
    ~Element() override;

    /*!
     * Inserts as TreeNode::insert() does, then performs InsertedOperation on every inserted element through its module.
     */
    void insert(int position, const QList<TreeNode *> &nodes) override;
    /*!
     * Removes as TreeNode::removeAt() does, then performs RemovedOperation on every removed element through its module.
     */
    void removeAt(int position, int count) override;
    //! One column.
    int columnCount() const override;
    /*!
     * The title (display), the default icon (decoration) and toolTipText() in
     * column 0; Qt::UserRole + 4, + 5 and + 6 give the title, the element type and
     * the element's own group type in any column.
     */
    QVariant data(int column, int role) const override;
    //! True while requireLoad() is set and the element offers ReadContentOperation.
    bool canFetchMore() const override;
    //! Clears requireLoad() and performs ReadContentOperation with no record.
    void fetchMore() override;

    // Virtual interface added to TreeNode's; the order of declaration is
    // part of the binary interface that plugins are built against.
    /*!
     * The widget that shows this element in \a role: the module's widget for the
     * element type, or null. A persistent element has no creation widget. The
     * widget container shows a create-role widget without an element; a
     * container element under which new elements are created overrides this to
     * tell its widget where they go (CreateTask's afterRun() asks the container
     * for its create-role widget too).
     */
    virtual ElementWidget *elementWidget(ElementWidgetRole role);
    //! The index of the current way of showing the children (see displayChildrenVariants()).
    virtual int displayChildrenVariant() const;
    //! The names of the ways the children can be shown, in combo-box order; none in the base.
    virtual QStringList displayChildrenVariants() const;
    //! The question asked before the element is deleted; defaultQuestionForRemove() in the base.
    virtual QString questionForRemove() const;

    using TreeNode::insert;

    //! The name shown in column 0.
    const QString &title() const { return _title; }
    /*! Sets the title and the id "<element type>_<title>"; ignored for a
     *  persistent element. */
    void setTitle(const QString &title);

    //! The last record read from or written to the system (owned), or null.
    ElementData *elementData() const { return _elementData; }
    /*! Replaces the record without deleting the previous one: the caller
     *  takes care of it. The element deletes the record it holds when it is
     *  destroyed. */
    void setElementData(ElementData *data) { _elementData = data; }

    /*! The element's own group type or, while that is undefined, the nearest
     *  ancestor element's defined one. */
    QString groupElementType() const;
    //! Whether the element is a fixed node of the tree (expected depth other than -1).
    bool isPersistent() const;
    //! Whether the children still have to be read.
    bool requireLoad() const { return _requireLoad; }

    //! The module's actions for this element's type.
    QList<QAction *> elementActions() const;

    //! The icon of elements that show none of their own: an empty icon.
    static const QIcon &defaultIcon();
    //! The translated "Do you really want to remove this element?".
    static const QString &defaultQuestionForRemove();

protected:
    //! The group the element stands for ("Undefined" by default); see groupElementType().
    QString _groupElementType;
    //! See elementData(); owned, deleted by the destructor.
    ElementData *_elementData;
    //! See requireLoad().
    bool _requireLoad;
    //! See title().
    QString _title;
    //! See displayChildrenVariant().
    int _displayChildrenVariant;
};

#endif // KVT_ELEMENT_H
