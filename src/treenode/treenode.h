#ifndef KVT_TREENODE_H
#define KVT_TREENODE_H

#include "kvtcommon_export.h"

#include <QList>
#include <QObject>
#include <QString>
#include <QVariant>

/*!
 * Base of every node shown in a tree: the root of the modules, modules,
 * elements and configuration nodes.
 *
 * A node keeps an ordered list of child pointers and a plain back-pointer to
 * the node holding it. The tree does not own its nodes: ownership stays with
 * the QObject parent or is given up explicitly with clearDelete() and
 * clearDeleteAll().
 *
 * Every change of a child list is announced by the node whose list changes,
 * and every node re-emits the eight notification signals of its children, so
 * whoever listens to the root hears every change in the tree.
 */
class KVTCOMMON_EXPORT TreeNode : public QObject
{
    Q_OBJECT

public:
    explicit TreeNode(QObject *parent = nullptr);
    TreeNode(int expectedDepth, const QString &expectedParentId, QObject *parent = nullptr);
    ~TreeNode() override;

    // Virtual interface; the order of declaration is part of the binary
    // interface that plugins are built against.
    virtual void insert(int position, const QList<TreeNode *> &nodes);
    virtual void removeAt(int position, int count);
    virtual void setAlternativeExpected(int alternative);
    virtual void afterLoad();
    virtual int treeNodeSpecialFlags() const;
    virtual int columnCount() const;
    virtual QVariant headerData(int section, Qt::Orientation orientation, int role) const;
    virtual QVariant data(int column, int role) const;
    virtual bool setData(int column, const QVariant &value, int role);
    virtual Qt::ItemFlags flags(int column) const;
    virtual bool canFetchMore() const;
    virtual void fetchMore();

    TreeNode *parentNode() const { return _parentNode; }
    void setParentNode(TreeNode *node) { _parentNode = node; }
    QList<TreeNode *> &childNodes() { return _childNodes; }
    const QList<TreeNode *> &childNodes() const { return _childNodes; }
    int childNodesCount() const { return _childNodes.size(); }
    QString id() const { return _id; }
    void setId(const QString &id) { _id = id; }
    QString expectedParentId() const { return _expectedParentId; }
    int expectedDepth() const { return _expectedDepth; }

    void append(TreeNode *node);
    void append(const QList<TreeNode *> &nodes);
    void insert(int position, TreeNode *node);
    void clear();
    void clearDelete();
    void clearDeleteAll();
    bool contains(TreeNode *node) const;
    int indexOf(TreeNode *node, int from = 0) const;
    bool removeOne(TreeNode *node);
    void reset();
    QList<TreeNode *> allChildNodes() const;
    void loadTreeFromList(const QList<TreeNode *> &nodes);

    void connectChildSignals(TreeNode *child);
    void disconnectChildSignals(TreeNode *child);

    /*!
     * The position of this node in its parent's child list, or -1 when it is
     * detached. Remembers where the node was last seen, so repeated lookups
     * in a long list do not scan it.
     */
    int row() const;

    void emitNodeDataChanged();
    void emitNodeChildsDataChanged();
    void emitSetCurrentNode();
    void emitExpandCurrentNode();

Q_SIGNALS:
    void nodesAboutToBeInserted(TreeNode *parent, int first, int last);
    void nodesAboutToBeRemoved(TreeNode *parent, int first, int last);
    void nodesInserted();
    void nodesRemoved();
    void nodeDataChanged(TreeNode *node);
    void nodeChildsDataChanged(TreeNode *node);
    void setCurrentNode(TreeNode *node);
    void expandCurrentNode(TreeNode *node);

protected:
    TreeNode *_parentNode;
    QList<TreeNode *> _childNodes;
    QString _id;
    QString _expectedParentId;
    int _expectedDepth;
};

#endif // KVT_TREENODE_H
