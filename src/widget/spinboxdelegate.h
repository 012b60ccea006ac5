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
    explicit SpinBoxDelegate(QObject *parent = nullptr);
    ~SpinBoxDelegate() override;

    QWidget *createEditor(QWidget *parent, const QStyleOptionViewItem &option,
                          const QModelIndex &index) const override;
    void setEditorData(QWidget *editor, const QModelIndex &index) const override;
    void setModelData(QWidget *editor, QAbstractItemModel *model, const QModelIndex &index) const override;
};

#endif // KVT_SPINBOXDELEGATE_H
