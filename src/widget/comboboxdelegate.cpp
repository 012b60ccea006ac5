// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include "comboboxdelegate.h"

#include <QApplication>
#include <QComboBox>
#include <QPainter>
#include <QSignalBlocker>
#include <QStyle>
#include <QStyleOptionComboBox>

ComboBoxDelegate::ComboBoxDelegate(QObject *parent)
    : MiscStyledItemDelegate(parent)
    , _popupPending(false)
{
}

ComboBoxDelegate::~ComboBoxDelegate() = default;

void ComboBoxDelegate::paint(QPainter *painter, const QStyleOptionViewItem &option,
                             const QModelIndex &index) const
{
    QStyleOptionViewItem item(option);
    initStyleOption(&item, index);

    QStyleOptionComboBox box;
    box.QStyleOption::operator=(item);
    box.currentText = index.data(Qt::DisplayRole).toString();
    box.editable = false;
    box.frame = true;

    // The button takes the selection colour of the row, so a selected row
    // looks selected across its combo box cells too.
    const QPalette::ColorGroup group =
        (item.state & QStyle::State_Active) ? QPalette::Active : QPalette::Inactive;
    const QPalette::ColorRole role =
        (item.state & QStyle::State_Selected) ? QPalette::Highlight : QPalette::Base;
    box.palette.setBrush(QPalette::Active, QPalette::Button, item.palette.brush(group, role));

    QStyle *style = QApplication::style();
    style->drawComplexControl(QStyle::CC_ComboBox, &box, painter);
    style->drawControl(QStyle::CE_ComboBoxLabel, &box, painter);
}

QWidget *ComboBoxDelegate::createEditor(QWidget *parent, const QStyleOptionViewItem &,
                                        const QModelIndex &) const
{
    auto *editor = new QComboBox(parent);
    connect(editor, SIGNAL(currentIndexChanged( int )), this, SLOT(afterEditorChange()));
    _popupPending = true;
    return editor;
}

void ComboBoxDelegate::setEditorData(QWidget *editor, const QModelIndex &index) const
{
    auto *box = qobject_cast<QComboBox *>(editor);
    if (!box || !index.isValid())
        return;
    {
        const QSignalBlocker blocker(box);
        box->setCurrentIndex(index.data(Qt::EditRole).toInt());
    }
    if (_popupPending) {
        _popupPending = false;
        box->showPopup();
    }
}

void ComboBoxDelegate::setModelData(QWidget *editor, QAbstractItemModel *model, const QModelIndex &index) const
{
    auto *box = qobject_cast<QComboBox *>(editor);
    if (!box || !model || !index.isValid())
        return;
    model->setData(index, box->currentIndex(), Qt::EditRole);
}
