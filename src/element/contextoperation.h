// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CONTEXTOPERATION_H
#define KVT_CONTEXTOPERATION_H

#include "kvtcommon_export.h"
#include "operationtype.h"

#include <QString>
#include <QtGlobal>

class Element;
class ElementData;
class ElementWidget;
class Module;

/*!
 * Something numbered operations can be performed on: an element of the
 * element tree or the widget that edits one. It knows the module that owns
 * it, the rights predicate that decides whether the current user may change
 * things, its element type and which of the two it is.
 *
 * Operations are offered as a bit set of OperationType values. The offer is
 * advisory: performOperation() does not check it, the caller (a view, a
 * menu) does.
 */
class KVTCOMMON_EXPORT ContextOperation
{
public:
    //! Which of the two kinds of context an object is.
    enum ContextType {
        ElementContextType = 0,      //!< an Element
        ElementWidgetContextType = 1 //!< an ElementWidget
    };

    //! A rights predicate: whether the current process may change the module's things.
    typedef bool (*RightsPredicate)(const Module &);

    //! "Undefined": the element type of an element whose kind has not set one.
    static const QString undefinedElementType;
    //! "All": the element type that stands for every type.
    static const QString allElementType;

    /*!
     * Creates a context of kind \a contextType for \a module (not owned; it must
     * outlive the context) with the rights predicate \a rights, which may be null
     * (never editable). The element type starts as undefinedElementType.
     */
    ContextOperation(ContextType contextType, Module &module, RightsPredicate rights);
    //! Destroys the context.
    virtual ~ContextOperation();

    // Virtual interface; the order of declaration is part of the binary
    // interface that plugins are built against.
    /*!
     * The operations offered now, as a bit set of OperationType values. Views and
     * menus enable their actions by it. Nothing in the base.
     */
    virtual quint64 availableOperations() const;
    /*!
     * Performs \a type. Elements pass the operations they accept to
     * Module::performOperation() with themselves as context; see there for who
     * owns \a data. Does nothing in the base.
     */
    virtual void performOperation(OperationType type, ElementData *data, int flags);
    //! The tool tip of the element or widget; every concrete class supplies it.
    virtual QString toolTipText() const = 0;

    //! The module that owns the element or widget.
    Module &module() const { return _module; }
    /*!
     * The kind of element ("Undefined" until a subclass sets _elementType).
     * Modules keep one widget per element type.
     */
    const QString &elementType() const { return _elementType; }
    //! Whether this is an element or an element widget.
    ContextType contextType() const { return _contextType; }
    //! The rights predicate given to the constructor, or null.
    RightsPredicate rightsPredicate() const { return _rightsPredicate; }

    /*! False without a rights predicate; otherwise its answer for the module. */
    bool isEditable() const;

    /*! This object as an element, or null when it is not one. */
    Element *elementContext();
    /*! This object as an element widget, or null when it is not one. */
    ElementWidget *elementWidgetContext();

    /*! The text that names this context above its widgets: an element's
     *  title, or for an element widget its ElementWidget::caption(). */
    QString caption() const;

protected:
    //! See module().
    Module &_module;
    //! See rightsPredicate().
    RightsPredicate _rightsPredicate;
    //! See elementType(); a plugin's element or widget sets it in its constructor.
    QString _elementType;
    //! See contextType().
    ContextType _contextType;

private:
    Q_DISABLE_COPY(ContextOperation)
};

#endif // KVT_CONTEXTOPERATION_H
