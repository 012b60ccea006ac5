#ifndef KVT_CHOICETREENODEPROXYMODEL_H
#define KVT_CHOICETREENODEPROXYMODEL_H

#include "treenodemodelextension.h"

#include <QIdentityProxyModel>
#include <QSet>
#include <QString>

/*!
 * Lays ticked and blocked names over a tree-node model.
 *
 * A row is named by the display text of its nameColumn(). The ticked state of
 * a row is read and written through choiceRole() of the name column (and read
 * through blockRole() too). When choiceRole() is Qt::CheckStateRole the state
 * reads as Qt::Checked or Qt::Unchecked, otherwise as a bool.
 *
 * A blocked name cannot be changed and its row has no flags; it shows the
 * state of its nearest ancestor that is not blocked (ticked when there is
 * none), so a blocked child follows its parent.
 *
 * addNames() and removeNames() hold exactly the names ticked and unticked
 * since the last reset (setCheckedBlockedNames(), setCheckedNames()), so a
 * caller can apply just those changes.
 */
class KVTCOMMON_EXPORT ChoiceTreeNodeProxyModel : public QIdentityProxyModel,
                                                  public virtual TreeNodeModelExtension
{
    Q_OBJECT

public:
    ChoiceTreeNodeProxyModel(int nameColumn, int choiceRole, int blockRole, QObject *parent = nullptr);
    ~ChoiceTreeNodeProxyModel() override;

    int nameColumn() const { return _nameColumn; }
    int choiceRole() const { return _choiceRole; }
    int blockRole() const { return _blockRole; }
    QSet<QString> checkedNames() const { return _checkedNames; }
    QSet<QString> blockedNames() const { return _blockedNames; }
    QSet<QString> addNames() const { return _addNames; }
    QSet<QString> removeNames() const { return _removeNames; }

    void setCheckedBlockedNames(QSet<QString> checked, QSet<QString> blocked);
    void setCheckedNames(QSet<QString> checked);
    void setBlockedNames(QSet<QString> blocked);
    void clearAddRemoveNames();

    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    bool setData(const QModelIndex &index, const QVariant &value, int role = Qt::EditRole) override;
    Qt::ItemFlags flags(const QModelIndex &index) const override;

    TreeNode *rootNode() const override;
    TreeNode *toTreeNode(const QModelIndex &index) const override;
    TreeNode *toTreeNode(const QItemSelectionRange &range) const override;
    TreeNode *toTreeNode(const QItemSelection &selection) const override;
    QModelIndex treeNodeToIndex(TreeNode *node) const override;

Q_SIGNALS:
    void stateChanged();

protected:
    int _nameColumn;
    int _choiceRole;
    int _blockRole;
    QSet<QString> _checkedNames;
    QSet<QString> _blockedNames;
    QSet<QString> _addNames;
    QSet<QString> _removeNames;

private:
    QString nameOf(const QModelIndex &index) const;
    bool isTicked(const QModelIndex &index) const;
};

#endif // KVT_CHOICETREENODEPROXYMODEL_H
