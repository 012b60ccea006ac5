#ifndef KVT_NODESELEMENTWIDGET_H
#define KVT_NODESELEMENTWIDGET_H

#include "listelementwidget.h"

/*!
 * A plain list of the children of an element (the first level only,
 * without supplement elements), without header. Double-clicking an entry
 * makes that element the current node of the tree.
 *
 * The element read first stays the listed root: later reads, also for
 * another element, change nothing.
 */
class KVTCOMMON_EXPORT NodesElementWidget : public ListElementWidget
{
    Q_OBJECT

public:
    NodesElementWidget(const QString &type, Module &module, RightsPredicate check,
                       QWidget *parent = nullptr);
    ~NodesElementWidget() override;

    void read() override;

public Q_SLOTS:
    void choiceElement(const QModelIndex &index);
    void customContextMenuRequest(const QPoint &pos);
};

#endif // KVT_NODESELEMENTWIDGET_H
