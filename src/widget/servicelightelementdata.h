// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    //! Creates a record of a stopped service with an empty state text (state not known yet).
    ServiceLightElementData();
    //! Copies the map, the state and the state text.
    ServiceLightElementData(const ServiceLightElementData &other);
    //! Copies the map, the state and the state text.
    ServiceLightElementData &operator=(const ServiceLightElementData &other);
    //! Destroys the record.
    ~ServiceLightElementData() override;

    //! Whether the service runs.
    bool state() const { return _state; }
    //! The text shown for the state; empty while the state is not known.
    const QString &textState() const { return _textState; }

    /*! Stores \a state; an empty \a textState is replaced by the translated
     *  "started" or "stopped". */
    void setState(bool state, const QString &textState = QString());

protected:
    //! See state().
    bool _state;
    //! See textState().
    QString _textState;
};

#endif // KVT_SERVICELIGHTELEMENTDATA_H
