#ifndef KVT_CHOICEWIDGET_H
#define KVT_CHOICEWIDGET_H

#include "kvtcommon_export.h"

#include <QGroupBox>
#include <QItemSelection>
#include <QModelIndex>
#include <QSet>

class ChoiceDialog;
class ChoiceTreeNodeProxyModel;
class ChoiceTreeNodeSortFilterProxyModel;
class TreeNode;

namespace Ui {
class ChoiceWidget;
}

/*!
 * Shows the ticked names of a ChoiceTreeNodeProxyModel, with Add and Remove
 * buttons: Add opens a ChoiceDialog offering the names not ticked, Remove
 * unticks the selected names. Remove is enabled while a name is selected.
 *
 * With choosing disabled, nothing can be selected and Add is disabled: the
 * list only shows the choice.
 */
class KVTCOMMON_EXPORT ChoiceWidget : public QGroupBox
{
    Q_OBJECT

public:
    explicit ChoiceWidget(QWidget *parent = nullptr);
    ~ChoiceWidget() override;

    ChoiceTreeNodeProxyModel *choiceModel() const { return _choiceModel; }
    /*! Hands \a model (not owned) to the dialog and shows its ticked rows. */
    void setChoiceModel(ChoiceTreeNodeProxyModel *model);

    QSet<int> acceptColumns() const;
    /*! The columns of the choice model that the widget's list shows (all when
     *  empty). The dialog has its own, set through choiceDialog(). */
    void setAcceptColumns(const QSet<int> &columns);

    bool isChoiceEnabled() const { return _choiceEnabled; }
    void setChoiceEnabled(bool enabled);

    ChoiceDialog *choiceDialog() const { return _choiceDialog; }

Q_SIGNALS:
    void treeNodeDoubleClicked(TreeNode *node);

public Q_SLOTS:
    void unchoice();
    void doubleClicked(const QModelIndex &index);
    void selectionChanged(const QItemSelection &selection = QItemSelection());

protected:
    Ui::ChoiceWidget *_ui;
    ChoiceDialog *_choiceDialog;
    ChoiceTreeNodeSortFilterProxyModel *_model;
    ChoiceTreeNodeProxyModel *_choiceModel;
    bool _choiceEnabled;
};

#endif // KVT_CHOICEWIDGET_H
