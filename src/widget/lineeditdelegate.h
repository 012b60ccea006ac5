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
    explicit LineEditDelegate(QObject *parent = nullptr);
    ~LineEditDelegate() override;

    QWidget *createEditor(QWidget *parent, const QStyleOptionViewItem &option,
                          const QModelIndex &index) const override;
    void setEditorData(QWidget *editor, const QModelIndex &index) const override;
    void setModelData(QWidget *editor, QAbstractItemModel *model, const QModelIndex &index) const override;
};

#endif // KVT_LINEEDITDELEGATE_H
