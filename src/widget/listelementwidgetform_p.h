// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#ifndef KVT_LISTELEMENTWIDGETFORM_P_H
#define KVT_LISTELEMENTWIDGETFORM_P_H

class ElementTreeView;

// The form object of a list widget. The list widgets have forms of their
// own (a plain view, a view with filter controls); ListElementWidget holds
// either through this base and reaches the view that both have.
class ListElementWidgetForm
{
public:
    virtual ~ListElementWidgetForm() = default;
    virtual ElementTreeView *view() const = 0;
};

template <class Form>
class ListElementWidgetFormOf : public ListElementWidgetForm, public Form
{
public:
    ElementTreeView *view() const override { return this->_elementTreeView; }
};

#endif // KVT_LISTELEMENTWIDGETFORM_P_H
