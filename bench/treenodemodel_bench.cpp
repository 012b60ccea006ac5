// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// TreeNodeModel beside QStandardItemModel on the same shapes: building a tree
// under a connected model, walking it the way a view does, and data-changed
// notifications on random nodes. Also loadTreeFromList growth.

#include <kvt-common/treenode.h>
#include <kvt-common/treenodemodel.h>

#include <benchmark/benchmark.h>

#include <QCoreApplication>
#include <QStandardItemModel>

#include <memory>
#include <random>

namespace {

class BenchNode : public TreeNode
{
public:
    BenchNode(const QString &text, int depth = -1, const QString &parentId = QString())
        : TreeNode(depth, parentId)
        , text(text)
    {
        setId(text);
    }
    int columnCount() const override { return 1; }
    QVariant data(int, int role) const override
    {
        return role == Qt::DisplayRole ? QVariant(text) : QVariant();
    }
    QString text;
};

struct Shape
{
    int groups; // 0: a flat list
    int children;
};

Shape shapeOf(const benchmark::State &state)
{
    return state.range(0) == 0 ? Shape{0, 100000} : Shape{1000, 100};
}

// A tree of BenchNodes; the root owns every node through QObject.
struct OurTree
{
    std::unique_ptr<BenchNode> root{new BenchNode(QStringLiteral("root"))};
    QList<BenchNode *> all;

    // Nodes are made first and hung afterwards, the way loadTreeFromList is
    // used: a list of nodes is created, then attached in one pass.
    void build(const Shape &shape)
    {
        auto make = [this](const QString &text) {
            auto *node = new BenchNode(text);
            node->setParent(root.get());
            all.append(node);
            return node;
        };
        if (shape.groups == 0) {
            for (int i = 0; i < shape.children; ++i)
                make(QString::number(i));
            for (BenchNode *node : qAsConst(all))
                root->append(node);
            return;
        }
        QList<BenchNode *> groups;
        for (int g = 0; g < shape.groups; ++g) {
            groups.append(make(QString::number(g)));
            for (int i = 0; i < shape.children; ++i)
                make(QString::number(i));
        }
        int next = 0;
        for (int g = 0; g < shape.groups; ++g) {
            BenchNode *group = all.at(next++);
            root->append(group);
            for (int i = 0; i < shape.children; ++i)
                group->append(all.at(next++));
        }
    }
};

struct TheirTree
{
    QList<QStandardItem *> all;

    void build(QStandardItemModel &model, const Shape &shape)
    {
        auto make = [this](const QString &text) {
            auto *item = new QStandardItem(text);
            all.append(item);
            return item;
        };
        if (shape.groups == 0) {
            for (int i = 0; i < shape.children; ++i)
                model.appendRow(make(QString::number(i)));
            return;
        }
        for (int g = 0; g < shape.groups; ++g) {
            QStandardItem *group = make(QString::number(g));
            model.appendRow(group);
            for (int i = 0; i < shape.children; ++i)
                group->appendRow(make(QString::number(i)));
        }
    }
};

// What a view does for every row: index, parent, rowCount, data.
qint64 walk(const QAbstractItemModel &model, const QModelIndex &parent)
{
    qint64 sum = 0;
    const int rows = model.rowCount(parent);
    for (int row = 0; row < rows; ++row) {
        const QModelIndex index = model.index(row, 0, parent);
        sum += model.parent(index) == parent;
        sum += model.data(index).toString().size();
        if (model.rowCount(index) > 0)
            sum += walk(model, index);
    }
    return sum;
}

void ourBuild(benchmark::State &state)
{
    const Shape shape = shapeOf(state);
    for (auto _ : state) {
        OurTree tree;
        TreeNodeModel model(tree.root.get());
        tree.build(shape);
        benchmark::DoNotOptimize(model.rowCount());
        state.PauseTiming();
        model.setRootNode(nullptr);
        tree.root.reset();
        state.ResumeTiming();
    }
}

void theirBuild(benchmark::State &state)
{
    const Shape shape = shapeOf(state);
    for (auto _ : state) {
        QStandardItemModel model;
        TheirTree tree;
        tree.build(model, shape);
        benchmark::DoNotOptimize(model.rowCount());
        state.PauseTiming();
        model.clear();
        state.ResumeTiming();
    }
}

void ourWalk(benchmark::State &state)
{
    OurTree tree;
    tree.build(shapeOf(state));
    TreeNodeModel model(tree.root.get());
    for (auto _ : state)
        benchmark::DoNotOptimize(walk(model, QModelIndex()));
}

void theirWalk(benchmark::State &state)
{
    QStandardItemModel model;
    TheirTree tree;
    tree.build(model, shapeOf(state));
    for (auto _ : state)
        benchmark::DoNotOptimize(walk(model, QModelIndex()));
}

const int notifications = 10000;

// Data changes of random nodes, each announced by the node.
void changeRandomNodes(benchmark::State &state, OurTree &tree)
{
    std::mt19937 random(42);
    std::uniform_int_distribution<int> pick(0, tree.all.size() - 1);
    for (auto _ : state) {
        for (int i = 0; i < notifications; ++i) {
            BenchNode *node = tree.all.at(pick(random));
            node->text = QStringLiteral("changed");
            node->emitNodeDataChanged();
        }
    }
}

void ourNotify(benchmark::State &state)
{
    OurTree tree;
    tree.build(shapeOf(state));
    TreeNodeModel model(tree.root.get());
    qint64 heard = 0;
    QObject::connect(&model, &QAbstractItemModel::dataChanged, [&heard] { ++heard; });
    changeRandomNodes(state, tree);
    benchmark::DoNotOptimize(heard);
}

// The same changes heard at the root without a model: what the relay
// through every ancestor costs by itself, the floor under ourNotify.
void ourRelay(benchmark::State &state)
{
    OurTree tree;
    tree.build(shapeOf(state));
    qint64 heard = 0;
    QObject::connect(tree.root.get(), &TreeNode::nodeDataChanged, [&heard] { ++heard; });
    changeRandomNodes(state, tree);
    benchmark::DoNotOptimize(heard);
}

void theirNotify(benchmark::State &state)
{
    QStandardItemModel model;
    TheirTree tree;
    tree.build(model, shapeOf(state));
    qint64 heard = 0;
    QObject::connect(&model, &QAbstractItemModel::dataChanged, [&heard] { ++heard; });
    std::mt19937 random(42);
    std::uniform_int_distribution<int> pick(0, tree.all.size() - 1);
    int round = 0;
    for (auto _ : state) {
        const QString text = QString::number(++round); // a new value, so every call notifies
        for (int i = 0; i < notifications; ++i)
            tree.all.at(pick(random))->setText(text);
    }
    benchmark::DoNotOptimize(heard);
}

void ourLoadTreeFromList(benchmark::State &state)
{
    const int count = int(state.range(0));
    const int groups = count / 100;
    for (auto _ : state) {
        state.PauseTiming();
        BenchNode root(QString(), 0);
        QList<TreeNode *> nodes;
        for (int g = 0; g < groups; ++g) {
            const QString group = QStringLiteral("g%1").arg(g);
            nodes.append(new BenchNode(group, 1));
            for (int i = 1; i < 100; ++i)
                nodes.append(new BenchNode(QStringLiteral("n%1").arg(i), 2, group));
        }
        state.ResumeTiming();
        root.loadTreeFromList(nodes);
        state.PauseTiming();
        qDeleteAll(nodes);
        state.ResumeTiming();
    }
    state.SetComplexityN(count);
}

} // namespace

BENCHMARK(ourBuild)->Arg(0)->Arg(1)->Unit(benchmark::kMillisecond);
BENCHMARK(theirBuild)->Arg(0)->Arg(1)->Unit(benchmark::kMillisecond);
BENCHMARK(ourWalk)->Arg(0)->Arg(1)->Unit(benchmark::kMillisecond);
BENCHMARK(theirWalk)->Arg(0)->Arg(1)->Unit(benchmark::kMillisecond);
BENCHMARK(ourNotify)->Arg(0)->Arg(1)->Unit(benchmark::kMillisecond);
BENCHMARK(ourRelay)->Arg(0)->Arg(1)->Unit(benchmark::kMillisecond);
BENCHMARK(theirNotify)->Arg(0)->Arg(1)->Unit(benchmark::kMillisecond);
BENCHMARK(ourLoadTreeFromList)->Arg(10000)->Arg(100000)->Unit(benchmark::kMillisecond);

int main(int argc, char **argv)
{
    QCoreApplication app(argc, argv);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
