#include <kvt-common/confroottreenode.h>
#include <kvt-common/conftreenode.h>
#include <kvt-common/treenodemodel.h>

#include <QCoreApplication>
#include <cstdio>

int main(int argc, char **argv)
{
    QCoreApplication app(argc, argv);
    ConfRootTreeNode root;
    root.loadTreeFromList({new ConfTreeNode(QStringLiteral("port"), QStringLiteral("5432"), &root),
                           new ConfTreeNode(QStringLiteral("host"), QStringLiteral("localhost"), &root)});
    TreeNodeModel model(&root);
    std::printf("consumer: %d rows, %s/%s\n", model.rowCount(),
                qPrintable(model.headerData(0, Qt::Horizontal).toString()),
                qPrintable(model.headerData(1, Qt::Horizontal).toString()));
    return model.rowCount() == 2 ? 0 : 1;
}
