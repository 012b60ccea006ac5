// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_ELEMENTSELEMENTWIDGET_H
#define KVT_ELEMENTSELEMENTWIDGET_H

#include "listelementwidget.h"

/*!
 * A sortable list of the children of an element (the first level only,
 * without supplement elements, every column but the first) with a text
 * filter: a wildcard, a regular expression or a fixed string, matched
 * without regard to case against the shown columns. Double-clicking an
 * entry makes that element the current node of the tree.
 *
 * The first read (in the edit role, of an element that offers
 * ReadContentOperation) makes the element the listed root and restores the
 * header and the filter of the widget's element type from the
 * application's settings; the widget saves them again when it is destroyed.
 * A widget that has never been read writes nothing. Later reads ask the
 * element to read its children again when the module is in force reread
 * mode ("paranoid") or the children have not been read yet.
 *
 * Settings keys, for the element type T: "elementsElementWidget/THeaderState",
 * "elementsElementWidget/TFilterType" and "elementsElementWidget/TFilterValue".
 */
class KVTCOMMON_EXPORT ElementsElementWidget : public ListElementWidget
{
    Q_OBJECT

public:
    //! Creates the widget with element type \a type; see ListElementWidget.
    ElementsElementWidget(const QString &type, Module &module, RightsPredicate check,
                          QWidget *parent = nullptr);
    //! Saves the header and filter when the widget has been read.
    ~ElementsElementWidget() override;

    //! Lists the element's children (see the class description).
    void read() override;

    //! Restores the header state and the filter of the element type from the settings.
    void loadSettings();
    //! Stores the header state and the filter of the element type.
    void saveSettings() const;

public Q_SLOTS:
    //! Applies the filter type and text of the form to the list.
    void changeFilter();
    //! Makes the element of \a index the current node of the tree.
    void choiceElement(const QModelIndex &index);
    //! Relays the view's context menu request (see ListElementWidget).
    void customContextMenuRequest(const QPoint &pos);
};

#endif // KVT_ELEMENTSELEMENTWIDGET_H
