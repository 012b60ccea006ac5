// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Filtering a long element list by a regular expression: a
// FilterTreeNodeSortFilterProxyModel over an ElementModel beside a
// QSortFilterProxyModel over a QStandardItemModel holding the same rows,
// with the same pattern. Each iteration applies the pattern to the whole
// unfiltered list; taking it off again is not measured.
#include <kvt-common/elementmodel.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/filtertreenodesortfilterproxymodel.h>
#include <kvt-common/module.h>
#include <kvt-common/ordinaryelement.h>

#include <QRegExp>
#include <QSortFilterProxyModel>
#include <QStandardItemModel>

#include <benchmark/benchmark.h>

namespace {

class QuietModule : public Module
{
public:
    QuietModule() : Module(QStringLiteral("bench")) {}
    void performOperation(ContextOperation *, OperationType, ElementData *, int) override {}
};

class BenchElement : public OrdinaryElement
{
public:
    BenchElement(Module &module, const QString &title)
        : OrdinaryElement(module, Module::defaultTrue)
    {
        _elementType = QStringLiteral("user");
        setTitle(title);
    }
    QString toolTipText() const override { return title(); }
};

QString rowTitle(int row)
{
    return QStringLiteral("user%1").arg(row, 6, 10, QLatin1Char('0'));
}

// About one row in ten matches.
const QRegExp pattern(QStringLiteral("[37]5"));

template <typename Proxy>
void filterRuns(benchmark::State &state, Proxy &proxy)
{
    for (auto _ : state) {
        proxy.setFilterRegExp(pattern);
        benchmark::DoNotOptimize(proxy.rowCount());
        state.PauseTiming();
        proxy.setFilterRegExp(QRegExp());
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void BM_ElementModelRegExpFilter(benchmark::State &state)
{
    QuietModule module;
    // All elements first, then hung in one insertion: nodes created and
    // attached one by one would interleave in memory and slow every walk.
    QList<TreeNode *> elements;
    elements.reserve(int(state.range(0)));
    for (int row = 0; row < state.range(0); ++row)
        elements.append(new BenchElement(module, rowTitle(row)));
    ElementRootTreeNode root;
    root.append(elements);

    ElementModel model(&root);
    FilterTreeNodeSortFilterProxyModel proxy(0);
    proxy.setSourceModel(&model);
    filterRuns(state, proxy);

    root.clear();
    qDeleteAll(elements);
}

void BM_StandardItemModelRegExpFilter(benchmark::State &state)
{
    QStandardItemModel model;
    QList<QStandardItem *> items;
    items.reserve(int(state.range(0)));
    for (int row = 0; row < state.range(0); ++row)
        items.append(new QStandardItem(rowTitle(row)));
    model.invisibleRootItem()->appendRows(items);

    QSortFilterProxyModel proxy;
    proxy.setSourceModel(&model);
    filterRuns(state, proxy);
}

} // namespace

BENCHMARK(BM_ElementModelRegExpFilter)->Arg(100000)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_StandardItemModelRegExpFilter)->Arg(100000)->Unit(benchmark::kMillisecond);
BENCHMARK_MAIN();
