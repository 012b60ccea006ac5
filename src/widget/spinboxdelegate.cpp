// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "spinboxdelegate.h"

#include <QSignalBlocker>
#include <QSpinBox>

SpinBoxDelegate::SpinBoxDelegate(QObject *parent)
    : MiscStyledItemDelegate(parent)
{
}

SpinBoxDelegate::~SpinBoxDelegate() = default;

QWidget *SpinBoxDelegate::createEditor(QWidget *parent, const QStyleOptionViewItem &,
                                       const QModelIndex &) const
{
    auto *editor = new QSpinBox(parent);
    connect(editor, SIGNAL(valueChanged( int )), this, SLOT(afterEditorChange()));
    return editor;
}

void SpinBoxDelegate::setEditorData(QWidget *editor, const QModelIndex &index) const
{
    auto *box = qobject_cast<QSpinBox *>(editor);
    if (!box || !index.isValid())
        return;
    const QSignalBlocker blocker(box);
    box->setValue(index.data(Qt::EditRole).toInt());
}

void SpinBoxDelegate::setModelData(QWidget *editor, QAbstractItemModel *model, const QModelIndex &index) const
{
    auto *box = qobject_cast<QSpinBox *>(editor);
    if (!box || !model || !index.isValid())
        return;
    model->setData(index, box->value(), Qt::EditRole);
}
