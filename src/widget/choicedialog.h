// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_CHOICEDIALOG_H
#define KVT_CHOICEDIALOG_H

#include "abstractchoicedialog.h"

class ChoiceTreeNodeProxyModel;

/*!
 * Offers the names of a ChoiceTreeNodeProxyModel that are not ticked, with
 * the filter of AbstractChoiceDialog; accepting ticks the selected names,
 * which then leave the list.
 */
class KVTCOMMON_EXPORT ChoiceDialog : public AbstractChoiceDialog
{
    Q_OBJECT

public:
    //! Creates the dialog with its not-ticked proxy; give it a model with setChoiceModel().
    explicit ChoiceDialog(QWidget *parent = nullptr);
    //! Destroys the dialog; the choice model is not owned.
    ~ChoiceDialog() override;

    //! Ticks every selected name in the choice model.
    void makeChoice() override;

    //! Offers the names of \a model (not owned) that are not ticked.
    void setChoiceModel(ChoiceTreeNodeProxyModel *model);
};

#endif // KVT_CHOICEDIALOG_H
