// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/confroottreenode.h>
#include <kvt-common/conftreenode.h>
#include <kvt-common/kvtcommon_version.h>
#include <kvt-common/treenodemodel.h>

#include <QCoreApplication>
#include <cstdio>

#if !defined(KVTCOMMON_VERSION) || KVTCOMMON_VERSION < KVTCOMMON_VERSION_CHECK(0, 1, 0)
#error "the version header does not give the version"
#endif

// Prints the header in UTF-8 whatever the locale's encoding, so the caller can
// check which translation the library installed.
int main(int argc, char **argv)
{
    QCoreApplication app(argc, argv);
    ConfRootTreeNode root;
    root.loadTreeFromList({new ConfTreeNode(QStringLiteral("port"), QStringLiteral("5432"), &root),
                           new ConfTreeNode(QStringLiteral("host"), QStringLiteral("localhost"), &root)});
    TreeNodeModel model(&root);
    std::printf("consumer: %d rows, %s/%s, version %s\n", model.rowCount(),
                model.headerData(0, Qt::Horizontal).toString().toUtf8().constData(),
                model.headerData(1, Qt::Horizontal).toString().toUtf8().constData(),
                KVTCOMMON_VERSION_STRING);
    return model.rowCount() == 2 ? 0 : 1;
}
