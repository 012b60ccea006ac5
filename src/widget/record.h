// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_RECORD_H
#define KVT_RECORD_H

#include "kvtcommon_export.h"

#include <QVariant>

/*!
 * One row of a RecordModel: a small structured item that a module defines,
 * shown and edited cell by cell.
 *
 * A subclass sets the changed flag (setChanged()) whenever it changes; the
 * model only clears it, for all its records at once.
 */
class KVTCOMMON_EXPORT Record
{
public:
    //! Creates an unchanged record.
    Record();
    //! Destroys the record.
    virtual ~Record();

    //! The record holds nothing yet (a row the user added but did not fill).
    virtual bool isEmpty() const = 0;
    //! The record is complete and acceptable.
    virtual bool isValid() const = 0;
    //! Whether the user may edit \a column.
    virtual bool isEditable(int column) const = 0;
    //! The data of \a column for \a role, as a table model answers it.
    virtual QVariant data(int column, int role) const = 0;
    //! Takes \a value into \a column; false when it is not accepted.
    virtual bool setData(int column, const QVariant &value) = 0;

    //! Whether the record changed since it was loaded or last marked unchanged.
    bool isChanged() const { return _changed; }
    //! Marks the record unchanged.
    void unchange() { _changed = false; }

protected:
    //! Marks the record changed; a subclass calls it from setData().
    void setChanged(bool changed = true) { _changed = changed; }

    //! See isChanged().
    bool _changed;
};

#endif // KVT_RECORD_H
