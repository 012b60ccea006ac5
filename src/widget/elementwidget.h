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
    ElementWidget(Module &module, RightsPredicate check, QWidget *parent = nullptr);
    ~ElementWidget() override;

    // Virtual interface added to QWidget's; the order of declaration is part
    // of the binary interface that plugins are built against.
    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;
    virtual void setAlternativeExpected(int alternative);
    virtual void setElement(Element *element, ElementWidgetRole role);
    virtual void read();
    virtual QString caption() const;

    /*! Orders widgets offered for one element: lower priority first. (The
     *  name is kept as plugins know it.) */
    static bool priorityLessThen(const ElementWidget *a, const ElementWidget *b);

    Element *element() const { return _element; }
    ElementWidgetRole role() const { return _role; }
    int priority() const { return _priority; }
    /*! The supplement element type this widget stands for; "Undefined" for
     *  a widget that is not a supplement. */
    const QString &supplementElementWidgetType() const { return _supplementElementWidgetType; }

Q_SIGNALS:
    /*! The operations available on \a element, or the state of the element
     *  that decides them, have changed. */
    void elementContextOperationChanged(Element *element);

protected:
    void showEvent(QShowEvent *event) override;

    QString _supplementElementWidgetType;
    int _priority;
    Element *_element;
    ElementWidgetRole _role;
};

#endif // KVT_ELEMENTWIDGET_H
