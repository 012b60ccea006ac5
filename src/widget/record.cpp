#include "record.h"

Record::Record()
    : _changed(false)
{
}

Record::~Record() = default;
