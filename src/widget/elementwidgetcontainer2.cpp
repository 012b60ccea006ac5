// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementwidgetcontainer2.h"

#include "element.h"
#include "elementmodelextension.h"
#include "elementwidget.h"
#include "ui_elementwidgetcontainer2.h"
#include "vieweditelementwidget.h"

#include <QHash>
#include <QItemSelection>
#include <QPointer>

#include <algorithm>

namespace {

enum Page { EmptyPage = 0, TabsPage = 1, SinglePage = 2 };

// The object behind each container's caption source, watched: an element or
// widget destroyed while its caption is shown must not be asked again.
QHash<const ElementWidgetContainer2 *, QPointer<QObject>> &captionObjects()
{
    static QHash<const ElementWidgetContainer2 *, QPointer<QObject>> objects;
    return objects;
}

QIcon tabIcon(const ElementWidget *widget)
{
    const Element *element = widget->element();
    if (!element)
        return Element::defaultIcon();
    const QVariant icon = element->data(0, Qt::UserRole + 7);
    return icon.canConvert<QIcon>() ? icon.value<QIcon>() : QIcon();
}

} // namespace

ElementWidgetContainer2::ElementWidgetContainer2(QWidget *parent)
    : QWidget(parent)
    , _ui(new Ui::ElementWidgetContainer2)
    , _captionSource(nullptr)
{
    _ui->setupUi(this);
    // The caption is disabled so that it takes no focus, but should read
    // like any enabled line.
    QPalette palette = _ui->_captionLineEdit->palette();
    palette.setBrush(QPalette::Disabled, QPalette::Base, palette.brush(QPalette::Active, QPalette::Base));
    palette.setBrush(QPalette::Disabled, QPalette::Text, palette.brush(QPalette::Active, QPalette::Text));
    _ui->_captionLineEdit->setPalette(palette);
    _ui->_stackedWidget->setCurrentIndex(EmptyPage);
    connect(_ui->_tabWidget, SIGNAL(currentChanged( int )), this, SLOT(currentTabChanged( int )));
}

ElementWidgetContainer2::~ElementWidgetContainer2()
{
    // The widgets go back to their module before the pages holding them are
    // deleted; nobody is told, the container is going away.
    const QList<ElementWidget *> widgets = takeWidgets(_ui->_stackedWidget->currentIndex());
    for (ElementWidget *widget : widgets) {
        widget->setElement(nullptr, NoElementRole);
        disconnect(widget, SIGNAL(elementContextOperationChanged( Element * )), this,
                   SIGNAL(elementContextOperationChanged( Element * )));
    }
    captionObjects().remove(this);
    delete _ui;
}

ElementWidget *ElementWidgetContainer2::currentElementWidget() const
{
    switch (_ui->_stackedWidget->currentIndex()) {
    case TabsPage:
        return qobject_cast<ElementWidget *>(_ui->_tabWidget->currentWidget());
    case SinglePage:
        return qobject_cast<ElementWidget *>(_ui->_wrapperGroupBox->widget());
    default:
        return qobject_cast<ElementWidget *>(_ui->_emptyWidget);
    }
}

void ElementWidgetContainer2::enableTabChange(bool enable)
{
    if (_ui->_stackedWidget->currentIndex() != TabsPage)
        return;
    const int current = _ui->_tabWidget->currentIndex();
    for (int i = 0; i < _ui->_tabWidget->count(); ++i) {
        if (i != current)
            _ui->_tabWidget->setTabEnabled(i, enable);
    }
}

void ElementWidgetContainer2::reset()
{
    const int page = _ui->_stackedWidget->currentIndex();
    if (page != EmptyPage) {
        _ui->_captionLineEdit->clear();
        setCaptionSource(nullptr, nullptr);
        // The empty page goes up first: the tabs removed below then make no
        // other tab visible, which would read its element.
        _ui->_stackedWidget->setCurrentIndex(EmptyPage);
    }
    const QList<ElementWidget *> widgets = takeWidgets(page);
    for (ElementWidget *widget : widgets) {
        widget->setElement(nullptr, NoElementRole);
        disconnect(widget, SIGNAL(elementContextOperationChanged( Element * )), this,
                   SIGNAL(elementContextOperationChanged( Element * )));
    }
    Q_EMIT elementContextOperationChanged(nullptr);
    Q_EMIT elementWidgetChanged(nullptr);
}

void ElementWidgetContainer2::setCurrentElementWidget(const QItemSelection &selection,
                                                      ElementWidgetRole role)
{
    const ElementModelExtension *extension = nullptr;
    for (const QItemSelectionRange &range : selection) {
        extension = dynamic_cast<const ElementModelExtension *>(range.model());
        if (extension)
            break;
    }
    Element *element = extension ? extension->toElement(selection) : nullptr;
    if (!element) {
        reset();
        return;
    }

    // The same element again (a tab's own element, chosen in the tree after
    // a tab change) only switches tabs.
    if (_ui->_stackedWidget->currentIndex() == TabsPage) {
        for (int i = 0; i < _ui->_tabWidget->count(); ++i) {
            const auto *widget = qobject_cast<ElementWidget *>(_ui->_tabWidget->widget(i));
            if (widget && widget->element() == element) {
                if (_ui->_tabWidget->currentIndex() != i)
                    _ui->_tabWidget->setCurrentIndex(i);
                return;
            }
        }
    }
    if (_ui->_stackedWidget->currentIndex() != EmptyPage)
        reset();

    ElementWidget *main = element->elementWidget(role);

    if (role == CreateElementRole) {
        if (!main)
            return;
        // The element is dropped before the caption is asked for: the
        // widget may still point at an element of its last use.
        main->setElement(nullptr, CreateElementRole);
        setCaptionSource(main, main);
        _ui->_wrapperGroupBox->insertWidget(main);
        _ui->_stackedWidget->setCurrentIndex(SinglePage);
        Q_EMIT elementWidgetChanged(main);
        if (auto *editor = qobject_cast<ViewEditElementWidget *>(main))
            editor->beforeCreation();
        return;
    }

    // A supplement chosen in the tree shows the widgets of its parent.
    if (main && main->supplementElementWidgetType() != ContextOperation::undefinedElementType) {
        element = qobject_cast<Element *>(element->parentNode());
        if (!element)
            return;
        main = element->elementWidget(role);
    }

    QList<ElementWidget *> widgets;
    if (main) {
        main->setElement(element, role);
        widgets.append(main);
    }
    const QString mainType = main ? main->elementType() : ContextOperation::allElementType;
    const QList<TreeNode *> children = element->childNodes();
    for (TreeNode *child : children) {
        auto *childElement = qobject_cast<Element *>(child);
        ElementWidget *widget = childElement ? childElement->elementWidget(role) : nullptr;
        if (!widget)
            continue;
        const QString &type = widget->supplementElementWidgetType();
        if (type == ContextOperation::undefinedElementType
            || (type != ContextOperation::allElementType && type != mainType))
            continue;
        // A widget shows one element: two children sharing a widget give
        // one tab, for the first of them.
        if (widgets.contains(widget))
            continue;
        widget->setElement(childElement, role);
        widgets.append(widget);
    }
    if (widgets.isEmpty())
        return;

    if (widgets.size() == 1)
        showSingle(widgets.first());
    else
        showTabs(widgets, main);

    if (main)
        setCaptionSource(main, main);
    else
        setCaptionSource(element, element);
}

void ElementWidgetContainer2::updateCaption()
{
    const bool alive = _captionSource && captionObjects().value(this);
    _ui->_captionLineEdit->setText(alive ? _captionSource->caption() : QString());
}

void ElementWidgetContainer2::currentTabChanged(int index)
{
    if (index == -1 || _ui->_tabWidget->count() == 0)
        return;
    auto *widget = qobject_cast<ElementWidget *>(_ui->_tabWidget->widget(index));
    if (!widget)
        return;
    Element *element = widget->element();
    if (!element)
        return;
    element->emitSetCurrentNode();
    Q_EMIT elementContextOperationChanged(element);
    Q_EMIT elementWidgetChanged(widget);
}

void ElementWidgetContainer2::setCaptionSource(ContextOperation *source, QObject *object)
{
    _captionSource = source;
    if (object)
        captionObjects().insert(this, object);
    else
        captionObjects().remove(this);
    updateCaption();
}

QList<ElementWidget *> ElementWidgetContainer2::takeWidgets(int page)
{
    QList<QWidget *> taken;
    if (page == TabsPage) {
        QTabWidget *tabs = _ui->_tabWidget;
        const bool blocked = tabs->blockSignals(true);
        while (tabs->count() > 0) {
            taken.append(tabs->widget(0));
            tabs->removeTab(0);
        }
        tabs->blockSignals(blocked);
    } else if (page == SinglePage) {
        if (QWidget *widget = _ui->_wrapperGroupBox->widget()) {
            taken.append(widget);
            _ui->_wrapperGroupBox->removeWidget();
        }
    }
    QList<ElementWidget *> widgets;
    for (QWidget *widget : qAsConst(taken)) {
        // Still a child of a page, the widget would die with the container.
        widget->setParent(nullptr);
        if (auto *elementWidget = qobject_cast<ElementWidget *>(widget))
            widgets.append(elementWidget);
    }
    return widgets;
}

void ElementWidgetContainer2::showSingle(ElementWidget *widget)
{
    _ui->_wrapperGroupBox->insertWidget(widget);
    connect(widget, SIGNAL(elementContextOperationChanged( Element * )), this,
            SIGNAL(elementContextOperationChanged( Element * )), Qt::UniqueConnection);
    Q_EMIT elementContextOperationChanged(widget->element());
    Q_EMIT elementWidgetChanged(widget);
    _ui->_stackedWidget->setCurrentIndex(SinglePage);
}

void ElementWidgetContainer2::showTabs(QList<ElementWidget *> widgets, ElementWidget *main)
{
    QTabWidget *tabs = _ui->_tabWidget;
    const bool blocked = tabs->blockSignals(true);
    // Equal priorities keep the order of the element's children.
    std::stable_sort(widgets.begin(), widgets.end(), ElementWidget::priorityLessThen);
    for (ElementWidget *widget : qAsConst(widgets)) {
        tabs->addTab(widget, tabIcon(widget), widget->windowTitle());
        connect(widget, SIGNAL(elementContextOperationChanged( Element * )), this,
                SIGNAL(elementContextOperationChanged( Element * )), Qt::UniqueConnection);
    }
    ElementWidget *current = main ? main : widgets.first();
    tabs->setCurrentWidget(current);
    tabs->blockSignals(blocked);
    Q_EMIT elementContextOperationChanged(current->element());
    Q_EMIT elementWidgetChanged(current);
    _ui->_stackedWidget->setCurrentIndex(TabsPage);
}
