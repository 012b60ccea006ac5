// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_LINEEDITDELEGATE_H
#define KVT_LINEEDITDELEGATE_H

#include "miscstyleditemdelegate.h"

/*!
 * Edits a text cell (Qt::EditRole) with a line edit; every keystroke is
 * written to the model at once, without waiting for Enter.
 */
class KVTCOMMON_EXPORT LineEditDelegate : public MiscStyledItemDelegate
{
    Q_OBJECT

public:
    //! Creates the delegate.
    explicit LineEditDelegate(QObject *parent = nullptr);
    //! Destroys the delegate.
    ~LineEditDelegate() override;

    //! Creates a line edit that commits every change.
    QWidget *createEditor(QWidget *parent, const QStyleOptionViewItem &option,
                          const QModelIndex &index) const override;
    //! Shows the cell's Qt::EditRole value.
    void setEditorData(QWidget *editor, const QModelIndex &index) const override;
    //! Writes the editor's value with Qt::EditRole.
    void setModelData(QWidget *editor, QAbstractItemModel *model, const QModelIndex &index) const override;
};

#endif // KVT_LINEEDITDELEGATE_H
