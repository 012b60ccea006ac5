// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/confroottreenode.h>

#include <QCoreApplication>
#include <QDirIterator>
#include <QFile>
#include <QLocale>
#include <QXmlStreamReader>
#include <QtTest>

class TranslationsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void installedAtStartup()
    {
        QCOMPARE(QLocale::system().language(), QLocale::Russian);
        ConfRootTreeNode root;
        QCOMPARE(root.headerData(0, Qt::Horizontal, Qt::DisplayRole).toString(),
                 QString::fromUtf8("Имя"));
        QCOMPARE(root.headerData(1, Qt::Horizontal, Qt::DisplayRole).toString(),
                 QString::fromUtf8("Значение"));
    }

    // Every message of the library has a finished Russian translation.
    void catalogueComplete()
    {
        QFile ts(QStringLiteral(KVT_TS_FILE));
        QVERIFY2(ts.open(QIODevice::ReadOnly), qPrintable(ts.fileName()));
        QXmlStreamReader xml(&ts);
        QStringList unfinished;
        QString source;
        int messages = 0;
        while (!xml.atEnd()) {
            xml.readNext();
            if (!xml.isStartElement())
                continue;
            if (xml.name() == QLatin1String("source")) {
                source = xml.readElementText();
                ++messages;
            } else if (xml.name() == QLatin1String("translation")) {
                const QString type = xml.attributes().value(QLatin1String("type")).toString();
                const QString text = xml.readElementText();
                if (type == QLatin1String("unfinished") || (text.isEmpty() && type != QLatin1String("vanished")
                                                            && type != QLatin1String("obsolete")))
                    unfinished.append(source);
            }
        }
        QVERIFY(!xml.hasError());
        QVERIFY(messages > 0);
        QVERIFY2(unfinished.isEmpty(), qPrintable(unfinished.join(QLatin1String(" | "))));
    }
};

QTEST_GUILESS_MAIN(TranslationsTest)
#include "tst_translations.moc"
