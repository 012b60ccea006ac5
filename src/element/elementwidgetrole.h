// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTWIDGETROLE_H
#define KVT_ELEMENTWIDGETROLE_H

/*! \file elementwidgetrole.h
 * The roles in which an element widget shows its element.
 */

/*! What an element widget is doing with its element. */
enum ElementWidgetRole {
    NoElementRole = 0,     //!< no element assigned
    EditElementRole = 1,   //!< shows an existing element and writes changes back to it
    CreateElementRole = 2  //!< prepares a new element; applying creates it
};

#endif // KVT_ELEMENTWIDGETROLE_H
