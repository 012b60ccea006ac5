// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTWIDGET_H
#define KVT_ELEMENTWIDGET_H

#include "contextoperation.h"
#include "elementwidgetrole.h"

#include <QString>
#include <QWidget>

class Element;
class Module;

/*!
 * Base of every widget that shows or edits one element of a module. It is a
 * QWidget and a ContextOperation at once: operations the user starts from
 * the widget are performed with the widget as their context, so that the
 * module and its tasks know which widget to give the result back to.
 *
 * The widget belongs to its module (Module::insertElementWidget()); the
 * element is assigned with setElement() by whoever shows the widget, and is
 * not owned. Every time the program shows the widget its content is read
 * again (read()); a show by the window system, such as restoring a
 * minimised window, reads nothing.
 *
 * The tool tip text of ContextOperation is left to the concrete widgets.
 */
class KVTCOMMON_EXPORT ElementWidget : public QWidget, public ContextOperation
{
    Q_OBJECT

public:
    /*!
     * Creates a widget of \a module whose editability \a check decides. Hand it
     * to Module::insertElementWidget(), which owns it from then on. Priority 500,
     * no element, NoElementRole.
     */
    ElementWidget(Module &module, RightsPredicate check, QWidget *parent = nullptr);
    //! Destroys the widget; the element is not touched.
    ~ElementWidget() override;

    // Virtual interface added to QWidget's; the order of declaration is part
    // of the binary interface that plugins are built against.
    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;
    //! Hook for a widget that can show its element in more than one way. Does nothing here.
    virtual void setAlternativeExpected(int alternative);
    /*!
     * Assigns \a element (not owned; may be null) in \a role. Called by
     * ElementWidgetContainer2 before it shows the widget and with null when it
     * takes the widget away.
     */
    virtual void setElement(Element *element, ElementWidgetRole role);
    /*!
     * Reads the element's content again. Called each time the program shows the
     * widget. Does nothing here.
     */
    virtual void read();
    //! The text shown above the widget: the element's caption, or empty without element.
    virtual QString caption() const;

    /*! Orders widgets offered for one element: lower priority first. (The
     *  name is kept as plugins know it.) */
    static bool priorityLessThen(const ElementWidget *a, const ElementWidget *b);

    //! The element shown, or null.
    Element *element() const { return _element; }
    //! What the widget is doing with its element.
    ElementWidgetRole role() const { return _role; }
    //! The order among the widgets shown for one element as tabs; lower first.
    int priority() const { return _priority; }
    /*! The supplement element type this widget stands for; "Undefined" for
     *  a widget that is not a supplement. */
    const QString &supplementElementWidgetType() const { return _supplementElementWidgetType; }

Q_SIGNALS:
    /*! The operations available on \a element, or the state of the element
     *  that decides them, have changed. */
    void elementContextOperationChanged(Element *element);

protected:
    //! Calls read() when the program (not the window system) shows the widget.
    void showEvent(QShowEvent *event) override;

    //! See supplementElementWidgetType(); a supplement widget sets it in its constructor.
    QString _supplementElementWidgetType;
    //! See priority(); 500 unless the derived widget sets another.
    int _priority;
    //! See element(); not owned.
    Element *_element;
    //! See role().
    ElementWidgetRole _role;
};

#endif // KVT_ELEMENTWIDGET_H
