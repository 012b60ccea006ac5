#ifndef KVT_CHANGEDISPLAYELEMENTDATA_H
#define KVT_CHANGEDISPLAYELEMENTDATA_H

#include "elementdata.h"

/*!
 * The parameter of the change-display operation: the display variant
 * requested for the children of a container element.
 */
class KVTCOMMON_EXPORT ChangeDisplayElementData : public ElementData
{
public:
    ChangeDisplayElementData();
    explicit ChangeDisplayElementData(int displayType);
    ChangeDisplayElementData(const ChangeDisplayElementData &other);
    ChangeDisplayElementData &operator=(const ChangeDisplayElementData &other);
    ~ChangeDisplayElementData() override;

    int displayType() const { return _displayType; }
    void setDisplayType(int displayType) { _displayType = displayType; }

protected:
    int _displayType;
};

#endif // KVT_CHANGEDISPLAYELEMENTDATA_H
