// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// A plugin of another host: its root object answers another interface.

#include <QObject>
#include <QtPlugin>

class OtherInterfacePlugin : public QObject
{
    Q_OBJECT
    Q_PLUGIN_METADATA(IID "org.example.other-host/1.0")
};

#include "otherplugin.moc"
