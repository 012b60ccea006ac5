// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    /*!
     * Creates the proxy; rows are named by the display text of \a nameColumn and
     * their ticked state is read and written through \a choiceRole (read through
     * \a blockRole too). All name sets start empty.
     */
    ChoiceTreeNodeProxyModel(int nameColumn, int choiceRole, int blockRole, QObject *parent = nullptr);
    //! Destroys the proxy.
    ~ChoiceTreeNodeProxyModel() override;

    //! The source column whose display text names a row.
    int nameColumn() const { return _nameColumn; }
    //! The role through which the ticked state is read and written.
    int choiceRole() const { return _choiceRole; }
    //! A second role that reads the same ticked state.
    int blockRole() const { return _blockRole; }
    //! The ticked names.
    QSet<QString> checkedNames() const { return _checkedNames; }
    //! The names the user may not change.
    QSet<QString> blockedNames() const { return _blockedNames; }
    //! Names ticked since the last reset that were not ticked before.
    QSet<QString> addNames() const { return _addNames; }
    //! Names unticked since the last reset that were ticked before.
    QSet<QString> removeNames() const { return _removeNames; }

    /*!
     * Replaces the ticked and blocked names within one model reset, empties
     * addNames() and removeNames() and emits stateChanged(); nothing happens when
     * both sets are unchanged.
     */
    void setCheckedBlockedNames(QSet<QString> checked, QSet<QString> blocked);
    /*!
     * Replaces the ticked names within one model reset, empties addNames() and
     * removeNames() and emits stateChanged(); nothing happens when unchanged.
     */
    void setCheckedNames(QSet<QString> checked);
    /*!
     * Replaces the blocked names within one model reset and emits stateChanged();
     * addNames() and removeNames() are kept. Nothing happens when unchanged.
     */
    void setBlockedNames(QSet<QString> blocked);
    //! Empties addNames() and removeNames(), for instance after they were applied; no signal.
    void clearAddRemoveNames();

    /*!
     * The ticked state for choiceRole() and blockRole() in the name column; the source's data otherwise.
     */
    QVariant data(const QModelIndex &index, int role = Qt::DisplayRole) const override;
    /*!
     * Ticks or unticks a name through choiceRole() in the name column, updating
     * addNames() and removeNames(), and emits dataChanged() and stateChanged().
     * Returns false for a blocked name or an unchanged state. Other edits go to
     * the source.
     */
    bool setData(const QModelIndex &index, const QVariant &value, int role = Qt::EditRole) override;
    //! No flags at all for the row of a blocked name; the source's flags otherwise.
    Qt::ItemFlags flags(const QModelIndex &index) const override;

    TreeNode *rootNode() const override;
    TreeNode *toTreeNode(const QModelIndex &index) const override;
    TreeNode *toTreeNode(const QItemSelectionRange &range) const override;
    TreeNode *toTreeNode(const QItemSelection &selection) const override;
    QModelIndex treeNodeToIndex(TreeNode *node) const override;

Q_SIGNALS:
    //! Emitted after every change of the name sets.
    void stateChanged();

protected:
    //! See nameColumn().
    int _nameColumn;
    //! See choiceRole().
    int _choiceRole;
    //! See blockRole().
    int _blockRole;
    //! See checkedNames().
    QSet<QString> _checkedNames;
    //! See blockedNames().
    QSet<QString> _blockedNames;
    //! See addNames().
    QSet<QString> _addNames;
    //! See removeNames().
    QSet<QString> _removeNames;

private:
    QString nameOf(const QModelIndex &index) const;
    bool isTicked(const QModelIndex &index) const;
};

#endif // KVT_CHOICETREENODEPROXYMODEL_H
