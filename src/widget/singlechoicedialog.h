// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_SINGLECHOICEDIALOG_H
#define KVT_SINGLECHOICEDIALOG_H

#include "abstractchoicedialog.h"

class TreeNode;
class TreeNodeModel;

/*!
 * Lets the user pick exactly one node of a tree, with the filter of
 * AbstractChoiceDialog. Nodes whose special flags have bit 1 are not
 * offered. Each showing starts without a selection; accepting stores the
 * selected node, read with choosenTreeNode().
 */
class KVTCOMMON_EXPORT SingleChoiceDialog : public AbstractChoiceDialog
{
    Q_OBJECT

public:
    /*!
     * Creates the dialog over the tree under \a rootNode (not owned; may be set later through treeNodeModel()).
     */
    explicit SingleChoiceDialog(TreeNode *rootNode = nullptr, QWidget *parent = nullptr);
    //! Destroys the dialog and its model; the tree is not touched.
    ~SingleChoiceDialog() override;

    //! Stores the selected node as choosenTreeNode().
    void makeChoice() override;

    /*! The node chosen when the dialog was last accepted, or null. (The
     *  name is spelled so on purpose: callers know it.) */
    TreeNode *choosenTreeNode() const { return _choosenTreeNode; }
    /*! The model of the tree offered; its root can be changed there. */
    TreeNodeModel *treeNodeModel() const { return _treeNodeModel; }

protected:
    //! Clears the selection, so each showing starts without a choice.
    void showEvent(QShowEvent *event) override;

    //! See treeNodeModel(); owned.
    TreeNodeModel *_treeNodeModel;
    //! See choosenTreeNode().
    TreeNode *_choosenTreeNode;
};

#endif // KVT_SINGLECHOICEDIALOG_H
