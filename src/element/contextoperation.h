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

    ContextOperation(ContextType contextType, Module &module, RightsPredicate rights);
    virtual ~ContextOperation();

    // Virtual interface; the order of declaration is part of the binary
    // interface that plugins are built against.
    virtual quint64 availableOperations() const;
    virtual void performOperation(OperationType type, ElementData *data, int flags);
    virtual QString toolTipText() const = 0;

    Module &module() const { return _module; }
    const QString &elementType() const { return _elementType; }
    ContextType contextType() const { return _contextType; }
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
    Module &_module;
    RightsPredicate _rightsPredicate;
    QString _elementType;
    ContextType _contextType;

private:
    Q_DISABLE_COPY(ContextOperation)
};

#endif // KVT_CONTEXTOPERATION_H
