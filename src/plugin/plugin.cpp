#include "plugin.h"

Plugin::Plugin(QObject *parent)
    : QObject(parent)
    , _availableOperationsClass(0)
{
}

Plugin::~Plugin() = default;

bool Plugin::isValid() const
{
    return true;
}
