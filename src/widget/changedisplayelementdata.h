// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    //! Creates a request for display variant 0.
    ChangeDisplayElementData();
    //! Creates a request for display variant \a displayType.
    explicit ChangeDisplayElementData(int displayType);
    //! Copies the map and the display type.
    ChangeDisplayElementData(const ChangeDisplayElementData &other);
    //! Copies the map and the display type.
    ChangeDisplayElementData &operator=(const ChangeDisplayElementData &other);
    //! Destroys the record.
    ~ChangeDisplayElementData() override;

    //! The index of the display variant asked for (see Element::displayChildrenVariants()).
    int displayType() const { return _displayType; }
    //! Sets the display variant asked for.
    void setDisplayType(int displayType) { _displayType = displayType; }

protected:
    //! See displayType().
    int _displayType;
};

#endif // KVT_CHANGEDISPLAYELEMENTDATA_H
