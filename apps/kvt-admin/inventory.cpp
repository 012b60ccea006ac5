// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later
#include "inventory.h"

#include "mainwindow.h"

#include <kvt-common/elementcontainer.h>
#include <kvt-common/plugin.h>
#include <kvt-common/plugincontainer.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/treenodemodel.h>

#include <QPluginLoader>
#include <QTextStream>

namespace {

void printTree(QTextStream &out, const QAbstractItemModel *model, const QModelIndex &parent, int depth)
{
    for (int row = 0; row < model->rowCount(parent); ++row) {
        const QModelIndex index = model->index(row, 0, parent);
        out << QString(depth * 2, QLatin1Char(' ')) << index.data().toString();
        QStringList extra;
        for (int column = 1; column < model->columnCount(parent); ++column) {
            const QModelIndex cell = index.sibling(row, column);
            const QVariant check = cell.data(Qt::CheckStateRole);
            if (check.isValid())
                extra << QStringLiteral("%1: %2")
                             .arg(model->headerData(column, Qt::Horizontal).toString(),
                                  check.toBool() ? Inventory::tr("on") : Inventory::tr("off"));
            const QString text = cell.data().toString();
            if (!text.isEmpty())
                extra << text;
        }
        if (!extra.isEmpty())
            out << "  [" << extra.join(QStringLiteral("; ")) << ']';
        out << '\n';
        printTree(out, model, index, depth + 1);
    }
}

} // namespace

int Inventory::print(MainWindow &window, QTextStream &out, QTextStream &err, int timeoutMs)
{
    const bool finished = window.readAllElements(timeoutMs);

    PluginContainer *plugins = window.pluginContainer();
    out << tr("Plugin files:") << '\n';
    const auto &entries = plugins->plugins();
    if (entries.isEmpty())
        out << "  " << tr("(none)") << '\n';
    for (int i = 0; i < entries.size(); ++i) {
        const Plugin *plugin = entries.at(i).second;
        if (plugin)
            out << "  " << tr("accepted") << ' ' << window.pluginFilePath(i) << ": " << plugin->name() << " - "
                << plugin->description() << '\n';
        else
            out << "  " << tr("refused") << "  " << window.pluginFilePath(i) << ": " << plugins->pluginError(i)
                << '\n';
    }
    out << tr("Modules:") << '\n';
    printTree(out, plugins->treeNodeModel(), QModelIndex(), 1);
    out << tr("Elements:") << '\n';
    printTree(out, window.elementContainer()->treeNodeModel(), QModelIndex(), 1);

    const auto &rows = TaskObserver::instance()->rows();
    bool problems = false;
    for (const TaskObserver::Row &row : rows) {
        const TaskDescription &task = row.description;
        if (task.status() != TaskDescription::Fail && task.status() != TaskDescription::Warning)
            continue;
        if (!problems)
            out << tr("Problems:") << '\n';
        problems = true;
        out << "  " << (task.status() == TaskDescription::Fail ? tr("fail") : tr("warning")) << ' '
            << task.description() << ": " << QString(task.message()).replace(QLatin1Char('\n'), QStringLiteral("\n    "))
            << '\n';
    }
    out.flush();
    if (!finished) {
        err << tr("kvt-admin: the elements were still being read after %1 seconds.").arg(timeoutMs / 1000) << '\n';
        err.flush();
        return 3;
    }
    return 0;
}
