// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#ifndef KVT_ADMIN_MODULEELEMENTFILTER_H
#define KVT_ADMIN_MODULEELEMENTFILTER_H

#include <kvt-common/elementsortfilterproxymodel.h>
#include <kvt-common/module.h>

#include <QPointer>


/*!
 * The element tree of one module: top-level elements of other modules are
 * hidden (a module's sub-modules count as its own). Without a module every
 * element is shown. Supplement elements, which the widget container shows
 * as tabs, are hidden in the tree.
 */
class ModuleElementFilter : public ElementSortFilterProxyModel
{
    Q_OBJECT

public:
    explicit ModuleElementFilter(QObject *parent = nullptr);

    Module *module() const { return _module; }
    void setModule(Module *module);

protected:
    bool filterAcceptsRow(int sourceRow, const QModelIndex &sourceParent) const override;

private:
    QPointer<Module> _module;
};

#endif
