// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Filling an element tree: every element inserted below an element root is
// announced to its module (InsertedOperation) and every removed one too
// (RemovedOperation). Measured beside QStandardItemModel filling and
// clearing the same number of rows, and beside plain tree nodes.
#include <kvt-common/element.h>
#include <kvt-common/elementroottreenode.h>
#include <kvt-common/module.h>
#include <kvt-common/ordinaryelement.h>

#include <QStandardItemModel>

#include <benchmark/benchmark.h>

namespace {

class CountingModule : public Module
{
public:
    CountingModule() : Module(QStringLiteral("bench")) {}
    void performOperation(ContextOperation *, OperationType, ElementData *, int) override
    {
        ++operations;
    }
    long operations = 0;
};

class BenchElement : public OrdinaryElement
{
public:
    BenchElement(Module &module, int n) : OrdinaryElement(module, Module::defaultTrue)
    {
        _elementType = QStringLiteral("user");
        setTitle(QString::number(n));
    }
    QString toolTipText() const override { return title(); }
};

void BM_ElementRootFillAndClear(benchmark::State &state)
{
    CountingModule module;
    QList<TreeNode *> elements;
    for (int i = 0; i < state.range(0); ++i)
        elements.append(new BenchElement(module, i));
    ElementRootTreeNode root;
    for (auto _ : state) {
        root.append(elements);
        root.clear();
    }
    benchmark::DoNotOptimize(module.operations);
    qDeleteAll(elements);
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

// The same with plain tree nodes: what the tree itself costs, without the
// module notifications.
void BM_TreeNodeFillAndClear(benchmark::State &state)
{
    QList<TreeNode *> nodes;
    for (int i = 0; i < state.range(0); ++i)
        nodes.append(new TreeNode);
    TreeNode root;
    for (auto _ : state) {
        root.append(nodes);
        root.clear();
    }
    qDeleteAll(nodes);
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void BM_StandardItemModelFillAndClear(benchmark::State &state)
{
    QStandardItemModel model;
    for (auto _ : state) {
        QList<QStandardItem *> items;
        items.reserve(int(state.range(0)));
        for (int i = 0; i < state.range(0); ++i)
            items.append(new QStandardItem(QString::number(i)));
        model.invisibleRootItem()->appendRows(items);
        model.removeRows(0, model.rowCount());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

} // namespace

BENCHMARK(BM_ElementRootFillAndClear)->Arg(100)->Arg(10000);
BENCHMARK(BM_TreeNodeFillAndClear)->Arg(100)->Arg(10000);
BENCHMARK(BM_StandardItemModelFillAndClear)->Arg(100)->Arg(10000);
BENCHMARK_MAIN();
