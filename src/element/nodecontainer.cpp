// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "nodecontainer.h"

NodeContainer::NodeContainer(QObject *parent)
    : QObject(parent)
    , _rootNode(nullptr)
    , _treeNodeModel(nullptr)
{
}

NodeContainer::~NodeContainer() = default;
