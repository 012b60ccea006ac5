#include "nodecontainer.h"

NodeContainer::NodeContainer(QObject *parent)
    : QObject(parent)
    , _rootNode(nullptr)
    , _treeNodeModel(nullptr)
{
}

NodeContainer::~NodeContainer() = default;
