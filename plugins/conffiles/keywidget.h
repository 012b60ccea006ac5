// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#ifndef CONFFILES_KEYWIDGET_H
#define CONFFILES_KEYWIDGET_H

#include <kvt-common/vieweditelementwidget.h>

#include <QPointer>

class FileElement;

namespace Ui {
class KeyWidget;
}

/*!
 * Shows and edits one key line: key, value and the line's comment. In the
 * edit role the key is fixed; in the create role it is typed, and the new
 * line goes into the file set with setCreateTarget().
 */
class KeyWidget : public ViewEditElementWidget
{
    Q_OBJECT

public:
    explicit KeyWidget(Module &module, QWidget *parent = nullptr);
    ~KeyWidget() override;

    void setCreateTarget(FileElement *file);
    FileElement *createTarget() const;

    QString toolTipText() const override;
    QString caption() const override;
    void beforeCreation() override;
    ElementData *exportElementData() const override;
    void afterSuccessfulRead(Element *element, ElementData *data) override;
    void reset() override;
    bool isContentValid() const override;
    void blockEditWidget(bool block) override;

private Q_SLOTS:
    void edited();

private:
    //! Why the content cannot be applied, or why the line cannot be changed.
    QString problem() const;
    void showProblem();

    Ui::KeyWidget *_ui;
    QPointer<FileElement> _createTarget;
};

#endif
