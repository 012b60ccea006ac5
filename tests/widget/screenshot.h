// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TEST_SCREENSHOT_H
#define KVT_TEST_SCREENSHOT_H

#include <QDir>
#include <QWidget>

// Keeps a picture of a widget under the build tree (screenshots/<name>.png)
// so that a person can look at the dialogs; returns whether it was written.
inline bool keepScreenshot(QWidget *widget, const QString &name)
{
    const QString dir = QStringLiteral(KVT_SCREENSHOT_DIR);
    return QDir().mkpath(dir) && widget->grab().save(dir + QLatin1Char('/') + name + QStringLiteral(".png"));
}

#endif
