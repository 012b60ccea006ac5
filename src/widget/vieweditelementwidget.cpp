// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "vieweditelementwidget.h"

#include "changedisplayelementdata.h"
#include "element.h"
#include "module.h"

#include <QMessageBox>
#include <QPointer>

namespace {

// contentChanged() values: bit 1 unsaved changes, bit 0 content valid.
const int contentUnchanged = 0;
const int contentChangedInvalid = 2;
const int contentChangedValid = 3;

// Special flag of a node that cannot simply be made current.
const int notSelectableFlag = 1;

} // namespace

ViewEditElementWidget::ViewEditElementWidget(Module &module, RightsPredicate check, QWidget *parent)
    : ElementWidget(module, check, parent)
    , _editBlocked(false)
    , _changed(false)
{
}

ViewEditElementWidget::~ViewEditElementWidget() = default;

quint64 ViewEditElementWidget::availableOperations() const
{
    return CreateOperation;
}

void ViewEditElementWidget::performOperation(OperationType type, ElementData *, int)
{
    if (type == CreateOperation)
        _module.performOperation(this, CreateOperation, exportElementData(), 0);
}

void ViewEditElementWidget::setElement(Element *element, ElementWidgetRole role)
{
    if (element == _element && role == _role)
        return;
    ElementWidget::setElement(element, role);
    reset();
    if (role == CreateElementRole) {
        blockEditWidget(false);
        // A new element starts out changed and not yet valid.
        Q_EMIT contentChanged(contentChangedInvalid);
    }
}

void ViewEditElementWidget::read()
{
    if (!_element || _role != EditElementRole)
        return;
    if (_element->availableOperations() & ReadPropertyOperation)
        _element->performOperation(ReadPropertyOperation, nullptr, 0);
}

void ViewEditElementWidget::beforeCreation()
{
}

ElementData *ViewEditElementWidget::exportElementData() const
{
    return nullptr;
}

void ViewEditElementWidget::afterSuccessfulRead(Element *element, ElementData *)
{
    blockEditWidget(false);
    // A read of an element shown before may end after the widget has moved
    // on: it frees the controls but says nothing about the current content.
    if (element == _element && _role == EditElementRole) {
        setUnchanged();
        Q_EMIT elementContextOperationChanged(element);
    }
}

void ViewEditElementWidget::afterSuccessfulImport(ElementData *)
{
    // Imported content is an unsaved change like any edit.
    changeContent();
}

void ViewEditElementWidget::afterSuccessfulUpdate()
{
}

void ViewEditElementWidget::applyContentChanges()
{
    if (_element) {
        if (_element->availableOperations() & UpdateOperation)
            _element->performOperation(UpdateOperation, exportElementData(), 0);
    } else if (availableOperations() & CreateOperation) {
        performOperation(CreateOperation, nullptr, 0);
    }
}

bool ViewEditElementWidget::linkExternalElements()
{
    return true;
}

void ViewEditElementWidget::reset()
{
    _changed = false;
    // The controls stay disabled until a read has succeeded.
    blockEditWidget(true);
}

bool ViewEditElementWidget::isContentValid() const
{
    return true;
}

void ViewEditElementWidget::blockEditWidget(bool block)
{
    if (block) {
        setEnabled(false);
        _editBlocked = true;
        return;
    }
    switch (_role) {
    case CreateElementRole:
        setEnabled(true);
        _editBlocked = false;
        break;
    case EditElementRole:
        setEnabled(isEditable());
        _editBlocked = !isEditable();
        break;
    case NoElementRole:
        // Nothing to edit: the enabled state is left to the caller.
        _editBlocked = false;
        break;
    }
}

void ViewEditElementWidget::setUnchanged()
{
    if (!_changed && _role != CreateElementRole)
        return;
    _changed = false;
    Q_EMIT contentChanged(contentUnchanged);
}

void ViewEditElementWidget::changeContent()
{
    _changed = true;
    Q_EMIT contentChanged(isContentValid() ? contentChangedValid : contentChangedInvalid);
}

void ViewEditElementWidget::setTreeNodeCurrent(TreeNode *node)
{
    auto *element = qobject_cast<Element *>(node);
    if (!element)
        return;
    const bool notSelectable = element->treeNodeSpecialFlags() & notSelectableFlag;
    if (notSelectable && !(element->availableOperations() & ChangeDisplayOperation))
        return;
    const QPointer<Element> guard(element);
    if (_changed) {
        const QMessageBox::StandardButton answer = QMessageBox::question(
            this, tr("Element activation"), tr("Changes not saved!\nContinue without saving?"),
            QMessageBox::Yes | QMessageBox::No, QMessageBox::No);
        // The element may have gone while the question was open.
        if (answer != QMessageBox::Yes || !guard)
            return;
    }
    // Only a creation is given up here. The changes of an edited element
    // stay flagged after the user agreed to go on: they are still unsaved.
    if (_role == CreateElementRole)
        setUnchanged();
    if (!notSelectable) {
        element->emitSetCurrentNode();
        return;
    }
    ChangeDisplayElementData data(0);
    element->performOperation(ChangeDisplayOperation, &data, 0);
    if (guard)
        element->emitSetCurrentNode();
}

void ViewEditElementWidget::noSetTreeNodeCurrent()
{
    QMessageBox::warning(this, tr("Element activation"),
                         tr("Activation of this element not supported!"), QMessageBox::Ok);
}
