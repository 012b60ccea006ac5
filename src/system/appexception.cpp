// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "appexception.h"

#include <QByteArray>
#include <QHash>
#include <QMutex>
#include <QMutexLocker>

namespace {

// The bytes handed out by what() live here, keyed by the exception that
// produced them, since an exception object carries nothing but its text.
// Exceptions are thrown and destroyed on any thread, hence the lock. The table
// is never destroyed, so exceptions that outlive static destruction still find
// it.
struct WhatTable
{
    QMutex mutex;
    QHash<const AppException *, QByteArray> bytes;
};

WhatTable &whatTable()
{
    static WhatTable *table = new WhatTable;
    return *table;
}

} // namespace

AppException::AppException(const QString &text)
    : _text(text)
{
}

AppException::AppException(const AppException &other)
    : QException(other)
    , _text(other._text)
{
}

AppException &AppException::operator=(const AppException &other)
{
    if (this != &other) {
        QException::operator=(other);
        _text = other._text;
        WhatTable &table = whatTable();
        QMutexLocker locker(&table.mutex);
        table.bytes.remove(this);
    }
    return *this;
}

AppException::~AppException() noexcept
{
    WhatTable &table = whatTable();
    QMutexLocker locker(&table.mutex);
    table.bytes.remove(this);
}

const char *AppException::what() const noexcept
{
    WhatTable &table = whatTable();
    QMutexLocker locker(&table.mutex);
    auto it = table.bytes.find(this);
    if (it == table.bytes.end())
        it = table.bytes.insert(this, _text.toLocal8Bit());
    return it->constData();
}
