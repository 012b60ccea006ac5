// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_LISTELEMENTWIDGET_H
#define KVT_LISTELEMENTWIDGET_H

#include "elementwidget.h"

class ElementModel;
class ElementTreeView;
class ListElementWidgetForm;
class ListWidgetProxyModel;
class QModelIndex;
class QPoint;

/*!
 * Base of the element widgets that list the children of their element:
 * the element is the root of an ElementModel, which the widget's
 * ListWidgetProxyModel filters into an ElementTreeView.
 *
 * The constructor's \a type becomes the widget's element type. The model is
 * made here; the proxy and the form with the view are made by the derived
 * widgets (NodesElementWidget, ElementsElementWidget), which also give the
 * root to the model when they are first read.
 *
 * The view's context menu request is emitted again as this widget's
 * customContextMenuRequested(), in global coordinates; the module relays it
 * (Module::connectElementWidgets()).
 */
class KVTCOMMON_EXPORT ListElementWidget : public ElementWidget
{
    Q_OBJECT

public:
    //! Creates the widget with element type \a type and its ElementModel; see ElementWidget.
    ListElementWidget(const QString &type, Module &module, RightsPredicate check,
                      QWidget *parent = nullptr);
    //! Destroys the widget, its model, proxy and form.
    ~ListElementWidget() override;

    /*! The tool tip of the listed element, or the window title without one. */
    QString toolTipText() const override;

    //! The model whose root is the listed element.
    ElementModel *model() const { return _model; }
    //! The proxy between model() and the view; made by the derived widget.
    ListWidgetProxyModel *proxy() const { return _proxy; }
    /*! The view of the form; null until a derived widget has built it. */
    ElementTreeView *elementTreeView() const;

protected:
    /*! Connects the view to the slots choiceElement(QModelIndex) and
     *  customContextMenuRequest(QPoint) that the derived widget declares,
     *  and its element signals to elementContextOperationChanged(). A view
     *  with sorting enabled is set to sort ascending on its first column. */
    void connectView();
    /*! Makes the element of the proxy index \a index the current node of
     *  the tree, clearing the view's selection first. */
    void chooseElement(const QModelIndex &index);
    /*! Emits customContextMenuRequested() for \a pos, a point of the view's
     *  viewport, in global coordinates. */
    void relayContextMenuRequest(const QPoint &pos);

    //! See model(); owned.
    ElementModel *_model;
    //! See proxy(); owned, made by the derived widget.
    ListWidgetProxyModel *_proxy;
    //! The form holding the view (and the filter controls of some widgets); owned.
    ListElementWidgetForm *_ui;
};

#endif // KVT_LISTELEMENTWIDGET_H
