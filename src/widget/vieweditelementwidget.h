#ifndef KVT_VIEWEDITELEMENTWIDGET_H
#define KVT_VIEWEDITELEMENTWIDGET_H

#include "elementwidget.h"

class TreeNode;

/*!
 * Base of the widgets that show an element's content and let the user
 * change it. It runs the cycle of reading, editing and applying:
 *
 * - setElement() assigns the element and resets the widget: no changes,
 *   controls blocked until a read succeeds. In the create role the controls
 *   are free at once and the content counts as changed and not yet valid.
 * - showing the widget reads the element (ReadPropertyOperation); the read
 *   task ends in afterSuccessfulRead(), which a derived widget overrides to
 *   fill its controls before calling this base.
 * - controls report edits through changeContent(); contentChanged() tells
 *   0 (no unsaved changes), 2 (changed, not valid) or 3 (changed, valid).
 * - applyContentChanges() updates the element, or creates a new one when
 *   the widget has none, with the record of exportElementData(). The record
 *   is new; the module's performOperation() takes it over (as a rule by
 *   handing it to its task) and deletes it when it starts nothing.
 * - in the create role the widget has no element (the container shows it
 *   with none); a module that needs to know where to create remembers the
 *   container element whose Element::elementWidget() was asked for role 2.
 *
 * A failed task calls no hook: the widget stays blocked after a failed read
 * and keeps its changes after a failed update.
 */
class KVTCOMMON_EXPORT ViewEditElementWidget : public ElementWidget
{
    Q_OBJECT

public:
    ViewEditElementWidget(Module &module, RightsPredicate check, QWidget *parent = nullptr);
    ~ViewEditElementWidget() override;

    quint64 availableOperations() const override;
    void performOperation(OperationType type, ElementData *data, int flags) override;
    void setElement(Element *element, ElementWidgetRole role) override;
    void read() override;

    // Virtual interface added to ElementWidget's; the order of declaration
    // is part of the binary interface that plugins are built against.
    virtual void beforeCreation();
    /*! The content as a new record that the task it is given to takes
     *  over; null in the base. */
    virtual ElementData *exportElementData() const;
    virtual void afterSuccessfulRead(Element *element, ElementData *data);
    virtual void afterSuccessfulImport(ElementData *data);
    virtual void afterSuccessfulUpdate();
    virtual void applyContentChanges();
    virtual bool linkExternalElements();
    virtual void reset();
    virtual bool isContentValid() const;
    virtual void blockEditWidget(bool block);

    bool isChanged() const { return _changed; }
    bool isEditBlocked() const { return _editBlocked; }
    /*! Forgets the unsaved changes and reports 0. In the create role 0 is
     *  reported even when nothing was changed. */
    void setUnchanged();

public Q_SLOTS:
    void changeContent();
    void setTreeNodeCurrent(TreeNode *node);
    void noSetTreeNodeCurrent();

Q_SIGNALS:
    void contentChanged(int state);

protected:
    bool _editBlocked;
    bool _changed;
};

#endif // KVT_VIEWEDITELEMENTWIDGET_H
