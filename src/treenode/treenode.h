// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    /*!
     * Creates a detached node with no children, an empty id and expected parent
     * id, and the expected depth -1. \a parent is the QObject parent, which owns
     * the node; it is unrelated to the node's place in a tree.
     */
    explicit TreeNode(QObject *parent = nullptr);
    /*!
     * Creates a detached node that loadTreeFromList() will hang at
     * \a expectedDepth under the node whose id is \a expectedParentId.
     */
    TreeNode(int expectedDepth, const QString &expectedParentId, QObject *parent = nullptr);
    /*!
     * Takes the node out of its parent's child list (with the parent's removal
     * signals) and detaches its children without destroying them.
     */
    ~TreeNode() override;

    // Virtual interface; the order of declaration is part of the binary
    // interface that plugins are built against.
    /*!
     * Inserts \a nodes before \a position (clamped to 0..childNodesCount()).
     * Emits nodesAboutToBeInserted() and nodesInserted() around the change, then
     * starts forwarding the new children's signals. An empty list does nothing.
     * Subclasses that must react to insertion reimplement this and call the base.
     */
    virtual void insert(int position, const QList<TreeNode *> &nodes);
    /*!
     * Detaches up to \a count children from \a position on (the count is cut at
     * the end of the list), announcing them with nodesAboutToBeRemoved() and
     * nodesRemoved(). The children are not destroyed. An out-of-range position or
     * a count below 1 does nothing.
     */
    virtual void removeAt(int position, int count);
    /*!
     * Hook for a node that can hang in more than one place: switches to another
     * pair of expected parent id and depth before a tree is loaded. Does nothing in
     * the base class.
     */
    virtual void setAlternativeExpected(int alternative);
    /*!
     * Called by loadTreeFromList() on every node it attached, in the order of
     * attachment, once the whole tree is built. Does nothing in the base class.
     */
    virtual void afterLoad();
    /*!
     * Bits that models and proxies read: bit 1 hides the node from proxies built
     * with the special-flags filter 1 (supplements), bit 2 marks it for proxies
     * built with the filter 2, which show only such nodes, and bit 4 declares it a
     * leaf that never shows an expander. The base returns 0.
     */
    virtual int treeNodeSpecialFlags() const;
    /*!
     * Number of columns. Models ask the root only: every level of a tree has the
     * root's columns. The base returns 0.
     */
    virtual int columnCount() const;
    //! Header of \a section; asked of the root only. The base returns an invalid QVariant.
    virtual QVariant headerData(int section, Qt::Orientation orientation, int role) const;
    /*!
     * Data of \a column for \a role. The base answers only the id roles, whatever
     * the column: Qt::UserRole + 2 (258) gives id(), Qt::UserRole + 3 (259) gives
     * expectedParentId().
     */
    virtual QVariant data(int column, int role) const;
    /*!
     * Edits \a column; returns true only when something changed, so that the model
     * announces the change. The base refuses every edit.
     */
    virtual bool setData(int column, const QVariant &value, int role);
    //! Item flags of \a column; selectable and enabled in the base class.
    virtual Qt::ItemFlags flags(int column) const;
    /*!
     * Whether the node has children that are not read yet (lazy loading through
     * fetchMore() when a view expands the node). False in the base class.
     */
    virtual bool canFetchMore() const;
    //! Starts reading the children that canFetchMore() announced. Does nothing in the base class.
    virtual void fetchMore();

    //! The node whose child list holds this one, or null when detached (not the QObject parent).
    TreeNode *parentNode() const { return _parentNode; }
    /*!
     * Sets the back-pointer only, without touching any child list. Used by
     * insert() and removeAt(); other callers rarely need it.
     */
    void setParentNode(TreeNode *node) { _parentNode = node; }
    /*!
     * The children in display order. Changing the list directly bypasses the
     * notification signals; use insert() and removeAt() for changes views must see.
     */
    QList<TreeNode *> &childNodes() { return _childNodes; }
    //! The children in display order.
    const QList<TreeNode *> &childNodes() const { return _childNodes; }
    //! Number of direct children.
    int childNodesCount() const { return _childNodes.size(); }
    /*!
     * The node's identity, which loadTreeFromList() matches against expectedParentId(); empty by default.
     */
    QString id() const { return _id; }
    //! Sets the identity; does not emit any signal.
    void setId(const QString &id) { _id = id; }
    //! The id of the node under which loadTreeFromList() hangs this node.
    QString expectedParentId() const { return _expectedParentId; }
    //! The depth at which loadTreeFromList() expects this node; -1 when not set.
    int expectedDepth() const { return _expectedDepth; }

    //! Appends \a node at the end through the virtual insert().
    void append(TreeNode *node);
    //! Appends \a nodes at the end through the virtual insert().
    void append(const QList<TreeNode *> &nodes);
    //! Inserts one node through the virtual insert().
    void insert(int position, TreeNode *node);
    //! Detaches all children through the virtual removeAt(); they are not destroyed.
    void clear();
    /*!
     * Detaches all children and destroys them. A destroyed child detaches its own
     * children, which survive.
     */
    void clearDelete();
    //! Detaches and destroys the whole subtree, depth first.
    void clearDeleteAll();
    //! Whether \a node is a direct child.
    bool contains(TreeNode *node) const;
    //! Position of \a node among the direct children at or after \a from, or -1.
    int indexOf(TreeNode *node, int from = 0) const;
    //! Detaches the direct child \a node through removeAt(); false when it is not a child.
    bool removeOne(TreeNode *node);
    //! Takes the node out of its parent's list, then detaches its own children.
    void reset();
    /*!
     * The direct children followed by the children of each of them: two levels,
     * not the whole subtree.
     */
    QList<TreeNode *> allChildNodes() const;
    /*!
     * Rebuilds the children of this node from a flat list: after clear(), the
     * nodes are sorted by expected depth and then by id, and each is appended to
     * the first node of the level just above whose id equals its expected parent
     * id. Siblings therefore come out ordered by id. A node whose depth skips a
     * level or whose parent is not found stays detached and remains the caller's.
     * Every attached node then gets afterLoad(); this node does not.
     */
    void loadTreeFromList(const QList<TreeNode *> &nodes);

    /*!
     * Forwards the eight notification signals of \a child as this node's own.
     * insert() calls it for every new child.
     */
    void connectChildSignals(TreeNode *child);
    //! Stops forwarding the signals of \a child; removeAt() calls it.
    void disconnectChildSignals(TreeNode *child);

    /*!
     * The position of this node in its parent's child list, or -1 when it is
     * detached. Remembers where the node was last seen, so repeated lookups
     * in a long list do not scan it.
     */
    int row() const;

    //! Emits nodeDataChanged() for this node: call it after the node's own columns changed.
    void emitNodeDataChanged();
    //! Emits nodeChildsDataChanged() for this node: the columns of all its children changed.
    void emitNodeChildsDataChanged();
    //! Emits setCurrentNode() for this node, asking views to make it current.
    void emitSetCurrentNode();
    //! Emits expandCurrentNode() for this node, asking views to expand it.
    void emitExpandCurrentNode();

Q_SIGNALS:
    //! Rows \a first to \a last are about to appear under \a parent.
    void nodesAboutToBeInserted(TreeNode *parent, int first, int last);
    //! Rows \a first to \a last under \a parent are about to go.
    void nodesAboutToBeRemoved(TreeNode *parent, int first, int last);
    //! The insertion announced last is done.
    void nodesInserted();
    //! The removal announced last is done.
    void nodesRemoved();
    //! The columns of \a node changed.
    void nodeDataChanged(TreeNode *node);
    //! The columns of all children of \a node changed.
    void nodeChildsDataChanged(TreeNode *node);
    //! Views are asked to make \a node current.
    void setCurrentNode(TreeNode *node);
    //! Views are asked to expand \a node.
    void expandCurrentNode(TreeNode *node);

protected:
    //! Back-pointer to the node holding this one; see parentNode().
    TreeNode *_parentNode;
    //! The children; see childNodes().
    QList<TreeNode *> _childNodes;
    //! See id().
    QString _id;
    //! See expectedParentId(); subclasses set it in their constructor.
    QString _expectedParentId;
    //! See expectedDepth(); subclasses set it in their constructor.
    int _expectedDepth;
};

#endif // KVT_TREENODE_H
