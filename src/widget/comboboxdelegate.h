// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_COMBOBOXDELEGATE_H
#define KVT_COMBOBOXDELEGATE_H

#include "miscstyleditemdelegate.h"

/*!
 * Edits an int cell (the index of the chosen item, Qt::EditRole) with a
 * combo box whose every selection is written to the model at once. The
 * editor opens already dropped down, once; filling it again later does not
 * reopen the list. Every cell of the column is painted as a combo box, edited
 * or not.
 *
 * createEditor() returns an empty box: the items are supplied by the user of
 * the delegate, typically a subclass that calls it and adds the texts.
 */
class KVTCOMMON_EXPORT ComboBoxDelegate : public MiscStyledItemDelegate
{
    Q_OBJECT

public:
    //! Creates the delegate.
    explicit ComboBoxDelegate(QObject *parent = nullptr);
    //! Destroys the delegate.
    ~ComboBoxDelegate() override;

    //! Paints the cell as a combo box showing the display text.
    void paint(QPainter *painter, const QStyleOptionViewItem &option, const QModelIndex &index) const override;
    //! Creates an empty combo box that commits every selection.
    QWidget *createEditor(QWidget *parent, const QStyleOptionViewItem &option,
                          const QModelIndex &index) const override;
    //! Selects the cell's index and, the first time, drops the list down.
    void setEditorData(QWidget *editor, const QModelIndex &index) const override;
    //! Writes the selected index with Qt::EditRole.
    void setModelData(QWidget *editor, QAbstractItemModel *model, const QModelIndex &index) const override;

protected:
    // Set by createEditor(), cleared once setEditorData() has opened the list.
    //! Set by createEditor(), cleared once setEditorData() has opened the list.
    mutable bool _popupPending;
};

#endif // KVT_COMBOBOXDELEGATE_H
