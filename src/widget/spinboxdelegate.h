// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_SPINBOXDELEGATE_H
#define KVT_SPINBOXDELEGATE_H

#include "miscstyleditemdelegate.h"

/*!
 * Edits an int cell (Qt::EditRole) with a spin box; every step is written
 * to the model at once. The spin box keeps its default range, 0 to 99; a
 * subclass widens it in createEditor().
 */
class KVTCOMMON_EXPORT SpinBoxDelegate : public MiscStyledItemDelegate
{
    Q_OBJECT

public:
    //! Creates the delegate.
    explicit SpinBoxDelegate(QObject *parent = nullptr);
    //! Destroys the delegate.
    ~SpinBoxDelegate() override;

    //! Creates a spin box that commits every change.
    QWidget *createEditor(QWidget *parent, const QStyleOptionViewItem &option,
                          const QModelIndex &index) const override;
    //! Shows the cell's Qt::EditRole value.
    void setEditorData(QWidget *editor, const QModelIndex &index) const override;
    //! Writes the editor's value with Qt::EditRole.
    void setModelData(QWidget *editor, QAbstractItemModel *model, const QModelIndex &index) const override;
};

#endif // KVT_SPINBOXDELEGATE_H
