// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_SERVICEELEMENT_H
#define KVT_SERVICEELEMENT_H

#include "element.h"

/*!
 * An element that stands for a system service. Its data is a
 * ServiceLightElementData; once the service state is known (a non-empty
 * state text) the element shows the theme's start or stop icon.
 *
 * It offers no operations of its own: service plugins decide them.
 */
class KVTCOMMON_EXPORT ServiceElement : public Element
{
    Q_OBJECT

public:
    //! Creates the element with an empty ServiceLightElementData.
    ServiceElement(Module &module, RightsPredicate rights);
    //! Destroys the element and its record.
    ~ServiceElement() override;

    //! Adds the start or stop icon in column 0 once the state is known.
    QVariant data(int column, int role) const override;

    /*! "media-playback-start" of the icon theme; null without one. */
    static QIcon startIcon();
    /*! "media-playback-stop" of the icon theme; null without one. */
    static QIcon stopIcon();
};

#endif // KVT_SERVICEELEMENT_H
