#ifndef KVT_READPROPERTYHEAVYTASK_H
#define KVT_READPROPERTYHEAVYTASK_H

#include "elementtask.h"

/*!
 * Reads the properties of \a element. A plugin derives from it, fills the
 * task's record in run(), and a successful read is handed to the element's
 * edit widget (ViewEditElementWidget::afterSuccessfulRead()).
 */
class KVTCOMMON_EXPORT ReadPropertyHeavyTask : public ElementTask
{
public:
    ReadPropertyHeavyTask(Element *element);
    ~ReadPropertyHeavyTask() override;

    void afterRun() override;
};

#endif // KVT_READPROPERTYHEAVYTASK_H
