// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "elementcontainer.h"

#include "element.h"
#include "elementroottreenode.h"
#include "module.h"
#include "elementmodel.h"

#include <QPointer>
#include <QVector>

ElementContainer::ElementContainer(QObject *parent)
    : NodeContainer(parent)
{
    _rootNode = new ElementRootTreeNode(this);
    connect(_rootNode, SIGNAL(setCurrentNode(TreeNode *)), this, SIGNAL(setCurrentNode(TreeNode *)));
    connect(_rootNode, SIGNAL(expandCurrentNode(TreeNode *)),
            this, SIGNAL(expandCurrentNode(TreeNode *)));
    _treeNodeModel = new ElementModel(_rootNode, this);
}

ElementContainer::~ElementContainer()
{
    // The model goes first: it must not watch the root being torn down.
    delete _treeNodeModel;
    _treeNodeModel = nullptr;
}

void ElementContainer::pluginContainerReset(const TreeNode *modulesRoot)
{
    // The rebuild is shown to views as one reset rather than as the row
    // moves that loading the list makes.
    _treeNodeModel->nodesAboutToBeReset();
    if (!modulesRoot) {
        _treeNodeModel->nodesReset();
        return;
    }

    // allChildNodes() reaches two levels below the root: modules hung
    // deeper contribute no elements of their own here.
    QList<TreeNode *> elements;
    const QList<TreeNode *> nodes = modulesRoot->allChildNodes();
    for (TreeNode *node : nodes) {
        if (const auto *module = qobject_cast<const Module *>(node))
            elements.append(module->elementNodes());
    }
    _rootNode->loadTreeFromList(elements);
    _treeNodeModel->nodesReset();

    // Guarded: a module's answer to the reset may rebuild part of the tree.
    QVector<QPointer<Element>> topLevel;
    for (TreeNode *node : qAsConst(_rootNode->childNodes())) {
        auto *element = qobject_cast<Element *>(node);
        if (element && (element->availableOperations() & ResetOperation))
            topLevel.append(element);
    }
    for (const QPointer<Element> &element : qAsConst(topLevel)) {
        if (element)
            element->performOperation(ResetOperation, nullptr, 0);
    }
}
