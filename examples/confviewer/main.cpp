// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Shows a key/value file (default /etc/os-release) as a tree of configuration
// nodes. Without a display the window is rendered offscreen to a PNG file and
// the listing is printed on standard output.

#include <kvt-common/confroottreenode.h>
#include <kvt-common/conftreenode.h>
#include <kvt-common/treenodemodel.h>

#include <QApplication>
#include <QFile>
#include <QHeaderView>
#include <QTextStream>
#include <QTreeView>

#include <cstdio>

namespace {

// Reads "NAME=value" lines; blank lines and comments are skipped, and one
// level of double or single quotes around the value is removed.
QList<TreeNode *> readKeyValueFile(const QString &path, QObject *owner, QString *error)
{
    QList<TreeNode *> nodes;
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly | QIODevice::Text)) {
        *error = QStringLiteral("cannot open %1: %2").arg(path, file.errorString());
        return nodes;
    }
    QTextStream in(&file);
    in.setCodec("UTF-8");
    while (!in.atEnd()) {
        const QString line = in.readLine().trimmed();
        if (line.isEmpty() || line.startsWith(QLatin1Char('#')))
            continue;
        const int eq = line.indexOf(QLatin1Char('='));
        if (eq <= 0)
            continue;
        QString value = line.mid(eq + 1).trimmed();
        if (value.size() >= 2 && (value.startsWith(QLatin1Char('"')) || value.startsWith(QLatin1Char('\'')))
            && value.endsWith(value.at(0)))
            value = value.mid(1, value.size() - 2);
        nodes.append(new ConfTreeNode(line.left(eq).trimmed(), value, owner));
    }
    return nodes;
}

} // namespace

int main(int argc, char **argv)
{
    const bool headless = qEnvironmentVariableIsEmpty("DISPLAY")
                          && qEnvironmentVariableIsEmpty("WAYLAND_DISPLAY");
    if (headless && qEnvironmentVariableIsEmpty("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", "offscreen");

    QApplication app(argc, argv);
    const QStringList args = app.arguments();
    const QString path = args.size() > 1 ? args.at(1) : QStringLiteral("/etc/os-release");

    ConfRootTreeNode root;
    QString error;
    const QList<TreeNode *> nodes = readKeyValueFile(path, &root, &error);
    if (!error.isEmpty()) {
        std::fprintf(stderr, "kvt-confviewer: %s\n", qPrintable(error));
        return 1;
    }
    // Every line expects depth 1 under the root (depth 0), so they all hang
    // there, ordered by id.
    root.loadTreeFromList(nodes);

    TreeNodeModel model(&root);
    QTreeView view;
    view.setWindowTitle(QStringLiteral("%1 - kvt-confviewer").arg(path));
    view.setModel(&model);
    view.setRootIsDecorated(false);
    view.setAlternatingRowColors(true);
    view.header()->setSectionResizeMode(0, QHeaderView::ResizeToContents);
    view.resize(640, 420);
    view.show();

    if (!headless)
        return app.exec();

    QTextStream out(stdout);
    out << model.headerData(0, Qt::Horizontal).toString() << '\t'
        << model.headerData(1, Qt::Horizontal).toString() << '\n';
    for (int row = 0; row < model.rowCount(); ++row)
        out << model.index(row, 0).data().toString() << '\t'
            << model.index(row, 1).data().toString() << '\n';
    out.flush();

    app.processEvents();
    const QString png = QStringLiteral(KVT_DEMO_SCREENSHOT);
    if (!view.grab().save(png)) {
        std::fprintf(stderr, "kvt-confviewer: cannot write %s\n", qPrintable(png));
        return 1;
    }
    std::fprintf(stderr, "kvt-confviewer: window rendered to %s\n", qPrintable(png));
    return 0;
}
