#ifndef KVT_ELEMENTWIDGETCONTAINER2_H
#define KVT_ELEMENTWIDGETCONTAINER2_H

#include "elementwidgetrole.h"
#include "kvtcommon_export.h"

#include <QWidget>

class ContextOperation;
class Element;
class ElementWidget;
class QItemSelection;

namespace Ui {
class ElementWidgetContainer2;
}

/*!
 * The panel that shows the element widgets of what is selected in an
 * element view. setCurrentElementWidget() asks the selected element for its
 * widget and gathers the widgets of its supplement children, then shows
 *
 * - nothing (the empty page), when there is no widget;
 * - one widget in a frame, when there is exactly one, or for the create
 *   role (CreateElementRole), where only the element's own widget is shown;
 * - several widgets as tabs, ordered by ascending priority, with the
 *   element's own widget as the current tab.
 *
 * A read-only line above shows the caption of the element's own widget, or
 * of the element when it has no widget. Switching tabs makes the tab's
 * element the current node of the tree. The widget on display relays its
 * elementContextOperationChanged() through the container, so that menus and
 * tool bars follow it.
 *
 * Element widgets belong to their module: the container never deletes one.
 * reset() takes every widget out again, leaving it without parent and
 * without element (setElement(nullptr, NoElementRole)); so does the
 * destructor, silently.
 */
class KVTCOMMON_EXPORT ElementWidgetContainer2 : public QWidget
{
    Q_OBJECT

public:
    explicit ElementWidgetContainer2(QWidget *parent = nullptr);
    ~ElementWidgetContainer2() override;

    /*! The widget on display: the single one, the current tab's, or null. */
    ElementWidget *currentElementWidget() const;
    /*! With tabs shown, enables or disables every tab but the current one
     *  (to keep the user on a widget with unsaved changes); otherwise does
     *  nothing. */
    void enableTabChange(bool enable);

Q_SIGNALS:
    void elementContextOperationChanged(Element *element);
    void elementWidgetChanged(ElementWidget *widget);

public Q_SLOTS:
    void reset();
    void setCurrentElementWidget(const QItemSelection &selection, ElementWidgetRole role);
    void updateCaption();
    void currentTabChanged(int index);

protected:
    Ui::ElementWidgetContainer2 *_ui;
    ContextOperation *_captionSource;

private:
    void setCaptionSource(ContextOperation *source, QObject *object);
    QList<ElementWidget *> takeWidgets(int page);
    void showSingle(ElementWidget *widget);
    void showTabs(QList<ElementWidget *> widgets, ElementWidget *main);
};

#endif // KVT_ELEMENTWIDGETCONTAINER2_H
