#ifndef KVT_CHOICEDIALOG_H
#define KVT_CHOICEDIALOG_H

#include "abstractchoicedialog.h"

class ChoiceTreeNodeProxyModel;

/*!
 * Offers the names of a ChoiceTreeNodeProxyModel that are not ticked, with
 * the filter of AbstractChoiceDialog; accepting ticks the selected names,
 * which then leave the list.
 */
class KVTCOMMON_EXPORT ChoiceDialog : public AbstractChoiceDialog
{
    Q_OBJECT

public:
    explicit ChoiceDialog(QWidget *parent = nullptr);
    ~ChoiceDialog() override;

    void makeChoice() override;

    void setChoiceModel(ChoiceTreeNodeProxyModel *model);
};

#endif // KVT_CHOICEDIALOG_H
