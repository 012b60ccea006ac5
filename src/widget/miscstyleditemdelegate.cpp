// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "miscstyleditemdelegate.h"

#include <QWidget>

MiscStyledItemDelegate::MiscStyledItemDelegate(QObject *parent)
    : QStyledItemDelegate(parent)
{
}

MiscStyledItemDelegate::~MiscStyledItemDelegate() = default;

void MiscStyledItemDelegate::updateEditorGeometry(QWidget *editor, const QStyleOptionViewItem &option,
                                                  const QModelIndex &) const
{
    if (editor)
        editor->setGeometry(option.rect);
}

void MiscStyledItemDelegate::afterEditorChange()
{
    // The view answers commitData() with setModelData(), so the model sees
    // every keystroke, step or selection.
    if (auto *editor = qobject_cast<QWidget *>(sender()))
        emit commitData(editor);
}
