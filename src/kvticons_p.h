// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_KVTICONS_P_H
#define KVT_KVTICONS_P_H

#include <QIcon>
#include <QString>

// The icon \a name of the desktop theme, or when the theme has none (no theme,
// or one without that name) the copy shipped in the library's resources, so
// every icon the library names shows an image. Needs the GUI application.
QIcon kvtThemeIcon(const QString &name);

// The library's own copy of the icon \a name (16, 22 and 32 pixels); null for
// a name the library does not ship.
QIcon kvtBundledIcon(const QString &name);

// The resource folder of the library's icons at 32 pixels, added to
// QIcon::fallbackSearchPaths() at start-up so that theme look-ups by name
// (Designer forms, host applications) find them too.
QString kvtBundledIconDir();

#endif // KVT_KVTICONS_P_H
