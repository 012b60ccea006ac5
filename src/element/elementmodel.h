#ifndef KVT_ELEMENTMODEL_H
#define KVT_ELEMENTMODEL_H

#include "elementmodelextension.h"
#include "treenodemodel.h"

/*!
 * The item model of an element tree: a TreeNodeModel whose indexes can also
 * be turned back into elements (toElement()).
 */
class KVTCOMMON_EXPORT ElementModel : public TreeNodeModel, public virtual ElementModelExtension
{
    Q_OBJECT

public:
    explicit ElementModel(QObject *parent = nullptr);
    explicit ElementModel(TreeNode *root, QObject *parent = nullptr);
    ~ElementModel() override;
};

#endif // KVT_ELEMENTMODEL_H
