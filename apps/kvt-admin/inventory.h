// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#ifndef KVT_ADMIN_INVENTORY_H
#define KVT_ADMIN_INVENTORY_H

#include <QCoreApplication>

class MainWindow;
class QTextStream;

//! The text kvt-admin --list prints.
class Inventory
{
    Q_DECLARE_TR_FUNCTIONS(Inventory)

public:
    /*!
     * Reads every element of \a window (at most \a timeoutMs), then prints
     * the plugin files tried, the module tree, the element tree and the
     * problems the tasks reported. Returns the exit code: 0, or 3 when the
     * reads did not finish in time.
     */
    static int print(MainWindow &window, QTextStream &out, QTextStream &err, int timeoutMs);
};

#endif
