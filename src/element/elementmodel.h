// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    //! Creates an empty model.
    explicit ElementModel(QObject *parent = nullptr);
    //! Creates a model of the tree under \a root (not owned).
    explicit ElementModel(TreeNode *root, QObject *parent = nullptr);
    //! Destroys the model.
    ~ElementModel() override;
};

#endif // KVT_ELEMENTMODEL_H
