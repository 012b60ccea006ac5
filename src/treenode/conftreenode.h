// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CONFTREENODE_H
#define KVT_CONFTREENODE_H

#include "treenode.h"

/*!
 * One name/value line of a configuration listing, shown under a
 * ConfRootTreeNode: the name in column 0, the value in column 1.
 */
class KVTCOMMON_EXPORT ConfTreeNode : public TreeNode
{
    Q_OBJECT

public:
    /*!
     * Creates the line \a name = \a value. The id becomes "Conf_<name>_<value>"
     * and the expected depth 1, so loadTreeFromList() hangs it directly under the
     * root.
     */
    ConfTreeNode(const QString &name, const QString &value, QObject *parent = nullptr);

    //! Column 0 the name, column 1 the value, for the display and tool-tip roles.
    QVariant data(int column, int role) const override;

    //! The name shown in column 0.
    QString name() const { return _name; }
    //! The value shown in column 1.
    QString value() const { return _value; }

protected:
    //! See name().
    QString _name;
    //! See value().
    QString _value;
};

#endif // KVT_CONFTREENODE_H
