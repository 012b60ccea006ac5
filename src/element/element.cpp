// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "element.h"

#include "elementdata.h"
#include "elementtask_p.h"
#include "elementtreeops_p.h"
#include "elementwidget_p.h"
#include "module.h"

#include <QSet>

namespace {

// Elements whose destructor is running. The classes derived from Element are
// already gone then, so what only they supply (the tool tip) cannot be asked
// for: a listener of the removal that ~Element announces gets nothing
// instead of a call to a pure virtual function.
thread_local QSet<const Element *> dyingElements;

} // namespace

Element::Element(Module &module, RightsPredicate rights)
    : TreeNode(nullptr)
    , ContextOperation(ElementContextType, module, rights)
    , _groupElementType(undefinedElementType)
    , _elementData(nullptr)
    , _requireLoad(false)
    , _displayChildrenVariant(0)
{
}

Element::~Element()
{
    // Leaving the tree while the element is still an Element: the removal
    // notifications reach the module with a usable context, and they may
    // still read the element's data.
    dyingElements.insert(this);
    reset();
    dyingElements.remove(this);
    // Widgets keep a plain pointer to their element: they let go of it now.
    KvtElementWidgets::elementDestroyed(this);
    // So do the tasks still queued or running for it: their afterRun() finds null.
    ElementTaskPrivate::elementDestroyed(this);
    delete _elementData;
    _elementData = nullptr;
}

void Element::insert(int position, const QList<TreeNode *> &nodes)
{
    ElementTreeOps::insert(this, position, nodes);
}

void Element::removeAt(int position, int count)
{
    ElementTreeOps::removeAt(this, position, count);
}

int Element::columnCount() const
{
    return 1;
}

QVariant Element::data(int column, int role) const
{
    switch (role) {
    case Qt::UserRole + 4:
        return _title;
    case Qt::UserRole + 5:
        return _elementType;
    case Qt::UserRole + 6:
        // The field itself: views group by what the element declares, not
        // by what it inherits from its ancestors.
        return _groupElementType;
    default:
        break;
    }
    if (column == 0) {
        switch (role) {
        case Qt::DisplayRole:
            return _title;
        case Qt::DecorationRole:
            return defaultIcon();
        case Qt::ToolTipRole:
            if (!dyingElements.isEmpty() && dyingElements.contains(this))
                return QVariant();
            return toolTipText();
        default:
            break;
        }
    }
    return TreeNode::data(column, role);
}

bool Element::canFetchMore() const
{
    return _requireLoad && (availableOperations() & ReadContentOperation);
}

void Element::fetchMore()
{
    if (!canFetchMore())
        return;
    // Cleared before the read starts, so a view asking again while the
    // read runs does not start a second one.
    _requireLoad = false;
    performOperation(ReadContentOperation, nullptr, 0);
}

ElementWidget *Element::elementWidget(ElementWidgetRole role)
{
    if (role == CreateElementRole && isPersistent())
        return nullptr;
    return _module.elementWidget(_elementType);
}

int Element::displayChildrenVariant() const
{
    return _displayChildrenVariant;
}

QStringList Element::displayChildrenVariants() const
{
    return QStringList();
}

QString Element::questionForRemove() const
{
    return defaultQuestionForRemove();
}

void Element::setTitle(const QString &title)
{
    if (isPersistent())
        return;
    _title = title;
    setId(QStringLiteral("%1_%2").arg(_elementType, title));
    emitNodeDataChanged();
}

QString Element::groupElementType() const
{
    if (_groupElementType != undefinedElementType)
        return _groupElementType;
    for (TreeNode *node = parentNode(); node; node = node->parentNode()) {
        const auto *element = qobject_cast<const Element *>(node);
        if (element && element->_groupElementType != undefinedElementType)
            return element->_groupElementType;
    }
    return _groupElementType;
}

bool Element::isPersistent() const
{
    return _expectedDepth != -1;
}

QList<QAction *> Element::elementActions() const
{
    return _module.elementActions(_elementType);
}

const QIcon &Element::defaultIcon()
{
    static const QIcon icon;
    return icon;
}

const QString &Element::defaultQuestionForRemove()
{
    static const QString question = tr("Do you really want to remove this element?");
    return question;
}
