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
    ConfTreeNode(const QString &name, const QString &value, QObject *parent = nullptr);

    QVariant data(int column, int role) const override;

    QString name() const { return _name; }
    QString value() const { return _value; }

protected:
    QString _name;
    QString _value;
};

#endif // KVT_CONFTREENODE_H
