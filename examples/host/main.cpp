// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// The demo host: the frame of an administration tool built on the library.
//
//   kvt-demo-host [plugin directory]
//
// Loads every plugin below the directory, shows the modules they contribute
// and the elements of all modules, and runs two worker threads for the tasks
// the modules start. Without a display the window is rendered offscreen to a
// PNG file and both trees are printed on standard output.

#include <kvt-common/elementcontainer.h>
#include <kvt-common/elementtreeview.h>
#include <kvt-common/plugincontainer.h>
#include <kvt-common/pluginmodel.h>
#include <kvt-common/taskobserver.h>
#include <kvt-common/thread.h>
#include <kvt-common/treenode.h>
#include <kvt-common/treenodemodel.h>

#include <QApplication>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLabel>
#include <QMainWindow>
#include <QMenuBar>
#include <QSplitter>
#include <QTextStream>
#include <QTreeView>
#include <QVBoxLayout>

#include <cstdio>
#include <memory>

namespace {

void printTree(QTextStream &out, const QAbstractItemModel *model, const QModelIndex &parent, int depth)
{
    for (int row = 0; row < model->rowCount(parent); ++row) {
        const QModelIndex index = model->index(row, 0, parent);
        out << QString(depth * 2, QLatin1Char(' ')) << index.data().toString();
        const QString second = model->columnCount(parent) > 1 ? index.sibling(row, 1).data().toString() : QString();
        if (!second.isEmpty())
            out << "  (" << second << ')';
        out << '\n';
        printTree(out, model, index, depth + 1);
    }
}

QWidget *titled(const QString &title, QWidget *content)
{
    auto *box = new QWidget;
    auto *layout = new QVBoxLayout(box);
    layout->setContentsMargins(4, 4, 4, 4);
    layout->addWidget(new QLabel(QStringLiteral("<b>%1</b>").arg(title)));
    layout->addWidget(content);
    return box;
}

} // namespace

int main(int argc, char **argv)
{
    const bool headless = qEnvironmentVariableIsEmpty("DISPLAY")
                          && qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY");
    if (headless && qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");

    QApplication app(argc, argv);
    QApplication::setApplicationName(QStringLiteral("kvt-demo-host"));
    const QStringList args = app.arguments();
    const QString pluginDir = args.size() > 1 ? args.at(1) : QStringLiteral(KVT_DEMO_PLUGIN_DIR);

    QMainWindow window;
    window.setWindowTitle(QStringLiteral("kvt demo host - %1").arg(pluginDir));

    // Tasks report to the observer, which lives in this thread; the workers
    // run them. Destroying the workers at the end stops them all.
    TaskObserver::instance(&window);
    std::unique_ptr<Thread> workers[2] = {std::make_unique<Thread>(), std::make_unique<Thread>()};
    for (auto &worker : workers)
        worker->start();

    PluginContainer plugins(&window);
    ElementContainer elements;
    // Every (re)load of the plugins rebuilds the element tree of all modules.
    QObject::connect(&plugins, &NodeContainer::nodeContainerReset, &elements,
                     [&elements](const TreeNode *root) { elements.pluginContainerReset(root); });

    auto *moduleView = new QTreeView;
    moduleView->setModel(plugins.treeNodeModel());
    moduleView->header()->setSectionResizeMode(QHeaderView::ResizeToContents);

    auto *elementView = new ElementTreeView;
    elementView->setModel(elements.treeNodeModel());
    QObject::connect(&elements, &NodeContainer::expandCurrentNode, elementView, [&](TreeNode *node) {
        elementView->expand(elements.treeNodeModel()->treeNodeToIndex(node));
    });

    auto *splitter = new QSplitter;
    splitter->addWidget(titled(QObject::tr("Modules"), moduleView));
    splitter->addWidget(titled(QObject::tr("Elements"), elementView));
    window.setCentralWidget(splitter);

    QMenu *menu = window.menuBar()->addMenu(QObject::tr("&Plugins"));
    menu->addAction(QObject::tr("&Plugins..."), &plugins, [&plugins] { plugins.showPluginDialog(); });
    menu->addAction(QObject::tr("&Tasks..."), TaskObserver::instance(), SLOT(openTaskObserveDialog()));
    menu->addAction(QObject::tr("&Quit"), &window, SLOT(close()));

    plugins.loadPlugins(pluginDir);
    moduleView->expandAll();
    elementView->expandAll();
    window.resize(900, 480);
    window.show();

    int result = 0;
    if (!headless) {
        result = app.exec();
    } else {
        QTextStream out(stdout);
        out << "Plugins below " << pluginDir << ":\n";
        printTree(out, plugins.pluginModel(), QModelIndex(), 1);
        out << "Modules:\n";
        printTree(out, plugins.treeNodeModel(), QModelIndex(), 1);
        out << "Elements:\n";
        printTree(out, elements.treeNodeModel(), QModelIndex(), 1);
        out.flush();
        app.processEvents();
        const QString png = QStringLiteral(KVT_DEMO_SCREENSHOT);
        if (window.grab().save(png)) {
            std::fprintf(stderr, "kvt-demo-host: window rendered to %s\n", qPrintable(png));
        } else {
            std::fprintf(stderr, "kvt-demo-host: cannot write %s\n", qPrintable(png));
            result = 1;
        }
    }
    // Modules and their elements go before the element tree that shows them.
    plugins.unloadPlugins();
    return result;
}
