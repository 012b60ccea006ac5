// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_TEST_TREESTRING_H
#define KVT_TEST_TREESTRING_H

#include <QModelIndex>
#include <QString>

class QAbstractItemModel;
class TreeNode;
class TestTreeNode;

/*!
 * Trees written as one string, for building fixtures and asserting results:
 * "a[a1 a2[x]] b" is a root with children a and b, a with children a1 and
 * a2, and a2 with child x. Ids are made of anything but blanks and brackets.
 */
namespace TreeString {

/*! Builds the children described by \a description under \a root; every new
 *  node is a TestTreeNode owned (as QObject) by \a root. */
void build(TreeNode *root, const QString &description);

/*! A new root (a TestTreeNode with id "root") holding \a description. */
TestTreeNode *makeTree(const QString &description, QObject *owner = nullptr);

/*! The children of \a node written in the same notation, by node id. */
QString fromTree(const TreeNode *node);

/*! The rows below \a parent written in the same notation, by the text of
 *  column 0 in \a role. */
QString fromModel(const QAbstractItemModel *model, const QModelIndex &parent = QModelIndex(),
                  int role = Qt::DisplayRole);

/*! The node below \a root reached by the path of ids "a/a2/x", or null. */
TreeNode *find(const TreeNode *root, const QString &path);

} // namespace TreeString

#endif
