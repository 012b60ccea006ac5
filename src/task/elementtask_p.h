#ifndef KVT_ELEMENTTASK_P_H
#define KVT_ELEMENTTASK_P_H

#include <QVariant>

class AbstractTask;
class Element;

namespace ElementTaskPrivate {

// The force reread mode ("paranoid") of the element's module, as stored:
// invalid when the module has no such value, or there is no element.
QVariant forceReread(const Element *element);

bool failed(const AbstractTask *task);

}

#endif
