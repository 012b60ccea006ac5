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
    explicit SingleChoiceDialog(TreeNode *rootNode = nullptr, QWidget *parent = nullptr);
    ~SingleChoiceDialog() override;

    void makeChoice() override;

    /*! The node chosen when the dialog was last accepted, or null. (The
     *  name is spelled so on purpose: callers know it.) */
    TreeNode *choosenTreeNode() const { return _choosenTreeNode; }
    /*! The model of the tree offered; its root can be changed there. */
    TreeNodeModel *treeNodeModel() const { return _treeNodeModel; }

protected:
    void showEvent(QShowEvent *event) override;

    TreeNodeModel *_treeNodeModel;
    TreeNode *_choosenTreeNode;
};

#endif // KVT_SINGLECHOICEDIALOG_H
