// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "lineeditdelegate.h"

#include <QLineEdit>
#include <QSignalBlocker>

LineEditDelegate::LineEditDelegate(QObject *parent)
    : MiscStyledItemDelegate(parent)
{
}

LineEditDelegate::~LineEditDelegate() = default;

QWidget *LineEditDelegate::createEditor(QWidget *parent, const QStyleOptionViewItem &,
                                        const QModelIndex &) const
{
    auto *editor = new QLineEdit(parent);
    // textEdited, not textChanged: only the user's typing is written back.
    connect(editor, SIGNAL(textEdited( QString )), this, SLOT(afterEditorChange()));
    return editor;
}

void LineEditDelegate::setEditorData(QWidget *editor, const QModelIndex &index) const
{
    auto *edit = qobject_cast<QLineEdit *>(editor);
    if (!edit || !index.isValid())
        return;
    // The view fills the editor again after each commit; the same text is
    // left alone so that the cursor stays where the user types.
    const QString text = index.data(Qt::EditRole).toString();
    if (edit->text() == text)
        return;
    const QSignalBlocker blocker(edit);
    edit->setText(text);
}

void LineEditDelegate::setModelData(QWidget *editor, QAbstractItemModel *model, const QModelIndex &index) const
{
    auto *edit = qobject_cast<QLineEdit *>(editor);
    if (!edit || !model || !index.isValid())
        return;
    model->setData(index, edit->text(), Qt::EditRole);
}
