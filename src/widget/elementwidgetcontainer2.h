// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
 *
 * A host window wires it to an element view and to the containers like
 * this (see also the main page):
 * \code
 * auto *view = new ElementTreeView;
 * view->setModel(elements.treeNodeModel());
 * auto *panel = new ElementWidgetContainer2;
 * // The selected element's widgets follow the selection and changes below it.
 * QObject::connect(view, &ElementTreeView::currentElementChangedStructure, panel, [view, panel] {
 *     panel->setCurrentElementWidget(view->selectionModel()->selection(), EditElementRole);
 * });
 * // Widgets belong to the modules: hand them back before a reload destroys them.
 * QObject::connect(&plugins, &NodeContainer::nodeContainerAboutToBeReset,
 *                  panel, &ElementWidgetContainer2::reset);
 * // An element that asks to become current (a finished create, delete or
 * // tab switch) is selected in the view, which in turn updates the panel.
 * QObject::connect(&elements, &NodeContainer::setCurrentNode, view, [&elements, view](TreeNode *node) {
 *     view->setCurrentIndex(elements.treeNodeModel()->treeNodeToIndex(node));
 * });
 * \endcode
 * For a "create" action, call setCurrentElementWidget() with the same
 * selection and CreateElementRole; the selected container's creation widget
 * is then shown alone. A window that keeps the user on unsaved changes
 * listens to PluginContainer::contentElementWidgetChanged() (2 or 3: changed)
 * and calls enableTabChange(false) meanwhile.
 */
class KVTCOMMON_EXPORT ElementWidgetContainer2 : public QWidget
{
    Q_OBJECT

public:
    //! Creates the empty panel.
    explicit ElementWidgetContainer2(QWidget *parent = nullptr);
    //! Hands every shown widget back without deleting it.
    ~ElementWidgetContainer2() override;

    /*! The widget on display: the single one, the current tab's, or null. */
    ElementWidget *currentElementWidget() const;
    /*! With tabs shown, enables or disables every tab but the current one
     *  (to keep the user on a widget with unsaved changes); otherwise does
     *  nothing. */
    void enableTabChange(bool enable);

Q_SIGNALS:
    /*!
     * The operations of \a element (the one on display, or null) may have changed; refresh menus and tool bars.
     */
    void elementContextOperationChanged(Element *element);
    //! Another widget (or none) is on display.
    void elementWidgetChanged(ElementWidget *widget);

public Q_SLOTS:
    /*!
     * Takes every widget out and shows the empty page; emits both signals with
     * null. Call it before the modules that own the widgets are unloaded.
     */
    void reset();
    /*!
     * Shows the widgets of the element selected in \a selection (of an element
     * model or proxy) in \a role, as described above.
     */
    void setCurrentElementWidget(const QItemSelection &selection, ElementWidgetRole role);
    //! Refreshes the caption line, for instance after the element was renamed.
    void updateCaption();
    //! Makes the element of tab \a index the current node of the tree.
    void currentTabChanged(int index);

protected:
    //! The form: caption line and the empty, tab and single pages.
    Ui::ElementWidgetContainer2 *_ui;
    //! Whose caption the caption line shows; not owned.
    ContextOperation *_captionSource;

private:
    void setCaptionSource(ContextOperation *source, QObject *object);
    QList<ElementWidget *> takeWidgets(int page);
    void showSingle(ElementWidget *widget);
    void showTabs(QList<ElementWidget *> widgets, ElementWidget *main);
};

#endif // KVT_ELEMENTWIDGETCONTAINER2_H
