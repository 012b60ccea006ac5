// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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
    //! Creates the widget; see ElementWidget.
    ViewEditElementWidget(Module &module, RightsPredicate check, QWidget *parent = nullptr);
    //! Destroys the widget.
    ~ViewEditElementWidget() override;

    //! CreateOperation: the widget can create a new element from its content.
    quint64 availableOperations() const override;
    /*!
     * For CreateOperation, asks the module to create an element from
     * exportElementData() (the module owns that record); other operations are
     * ignored.
     */
    void performOperation(OperationType type, ElementData *data, int flags) override;
    /*!
     * Assigns the element and resets the widget (see the class description);
     * nothing happens when both are unchanged.
     */
    void setElement(Element *element, ElementWidgetRole role) override;
    //! In the edit role, performs ReadPropertyOperation on the element when it offers it.
    void read() override;

    // Virtual interface added to ElementWidget's; the order of declaration
    // is part of the binary interface that plugins are built against.
    /*!
     * Called by the container when it shows the widget for creating a new element; clear the controls here.
     */
    virtual void beforeCreation();
    /*! The content as a new record that the task it is given to takes
     *  over; null in the base. */
    virtual ElementData *exportElementData() const;
    /*!
     * Called in the interface thread when a read of \a element succeeded, with the
     * task's record \a data (the task keeps owning it; copy what you need). Fill
     * the controls, then call this base, which frees them and reports 0 when
     * \a element is still the one shown.
     */
    virtual void afterSuccessfulRead(Element *element, ElementData *data);
    /*!
     * Called after a successful ImportTask with its record; the base counts the import as an unsaved change.
     */
    virtual void afterSuccessfulImport(ElementData *data);
    /*!
     * Called after a successful UpdateTask when the module trusts it (no force reread). Does nothing here.
     */
    virtual void afterSuccessfulUpdate();
    /*!
     * Writes the content: UpdateOperation on the element with
     * exportElementData(), or, without element, creates one.
     */
    virtual void applyContentChanges();
    //! Hook for linking elements of other modules into the content; true in the base.
    virtual bool linkExternalElements();
    //! Forgets the changes and blocks the controls until a read succeeds.
    virtual void reset();
    //! Whether the content can be applied; decides between 2 and 3 in contentChanged(). True here.
    virtual bool isContentValid() const;
    /*!
     * Disables the widget when \a block is true. Unblocking enables it in the
     * create role, and in the edit role only when the rights predicate allows.
     */
    virtual void blockEditWidget(bool block);

    //! Whether the content holds changes not yet applied.
    bool isChanged() const { return _changed; }
    //! Whether the controls are blocked.
    bool isEditBlocked() const { return _editBlocked; }
    /*! Forgets the unsaved changes and reports 0. In the create role 0 is
     *  reported even when nothing was changed. */
    void setUnchanged();

public Q_SLOTS:
    /*!
     * Connect the controls' change signals here: marks the content changed and emits contentChanged() 2 or 3.
     */
    void changeContent();
    /*!
     * Makes the element \a node current in the tree (for a link in the content),
     * asking first whether unsaved changes may be left.
     */
    void setTreeNodeCurrent(TreeNode *node);
    //! Tells the user that this element cannot be activated.
    void noSetTreeNodeCurrent();

Q_SIGNALS:
    /*!
     * The content changed: 0 no unsaved changes, 2 changed but not valid, 3
     * changed and valid. The module relays it (Module::connectElementWidgets()).
     */
    void contentChanged(int state);

protected:
    //! See isEditBlocked().
    bool _editBlocked;
    //! See isChanged().
    bool _changed;
};

#endif // KVT_VIEWEDITELEMENTWIDGET_H
