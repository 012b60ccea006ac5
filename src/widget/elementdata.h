// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTDATA_H
#define KVT_ELEMENTDATA_H

#include "kvtcommon_export.h"

#include <QMap>
#include <QString>
#include <QVariant>

/*!
 * The record in which data travels between elements, tasks and element
 * widgets: an open map from string keys to values, used directly through the
 * map interface. Keys the framework itself uses are "name", "xmlText",
 * "templateName", "htmlText" and "filePath"; every other key belongs to the
 * plugin that writes it.
 *
 * The record is polymorphic so that kinds carrying typed fields can be told
 * apart with a dynamic cast. It owns nothing but its values: copies are
 * cheap because the map is implicitly shared.
 */
class KVTCOMMON_EXPORT ElementData : public QMap<QString, QVariant>
{
public:
    //! Creates an empty record.
    ElementData();
    //! Copies the map of \a other.
    ElementData(const ElementData &other);
    //! Copies the map of \a other.
    ElementData &operator=(const ElementData &other);
    //! Destroys the record.
    virtual ~ElementData();

    /*! Hook through which a plugin's own kind prepares its parameters; the
     *  framework never calls it. Does nothing here. */
    virtual void configureParams();

    /*! The value under "name" as a string; empty when the key is absent. */
    QString name() const;
    //! Stores \a name under "name".
    void setName(const QString &name);

    /*!
     * Takes from \a other the values of the keys this record already has.
     * A key only \a other has is not added; a key \a other lacks keeps its
     * value. Only the map is touched, whatever the kinds of both records.
     */
    ElementData &importFrom(const ElementData &other);
};

#endif // KVT_ELEMENTDATA_H
