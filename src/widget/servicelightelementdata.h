#ifndef KVT_SERVICELIGHTELEMENTDATA_H
#define KVT_SERVICELIGHTELEMENTDATA_H

#include "elementdata.h"

/*!
 * The light property of a service element: whether the service runs and the
 * text shown for that state.
 */
class KVTCOMMON_EXPORT ServiceLightElementData : public ElementData
{
public:
    ServiceLightElementData();
    ServiceLightElementData(const ServiceLightElementData &other);
    ServiceLightElementData &operator=(const ServiceLightElementData &other);
    ~ServiceLightElementData() override;

    bool state() const { return _state; }
    const QString &textState() const { return _textState; }

    /*! Stores \a state; an empty \a textState is replaced by the translated
     *  "started" or "stopped". */
    void setState(bool state, const QString &textState = QString());

protected:
    bool _state;
    QString _textState;
};

#endif // KVT_SERVICELIGHTELEMENTDATA_H
