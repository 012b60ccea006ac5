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
    Record();
    virtual ~Record();

    //! The record holds nothing yet (a row the user added but did not fill).
    virtual bool isEmpty() const = 0;
    //! The record is complete and acceptable.
    virtual bool isValid() const = 0;
    virtual bool isEditable(int column) const = 0;
    virtual QVariant data(int column, int role) const = 0;
    //! Takes \a value into \a column; false when it is not accepted.
    virtual bool setData(int column, const QVariant &value) = 0;

    bool isChanged() const { return _changed; }
    void unchange() { _changed = false; }

protected:
    void setChanged(bool changed = true) { _changed = changed; }

    bool _changed;
};

#endif // KVT_RECORD_H
