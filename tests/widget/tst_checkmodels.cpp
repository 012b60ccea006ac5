// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/checkmiscmodel.h>
#include <kvt-common/configurecheckmodel.h>
#include <kvt-common/miscmodel.h>

#include "signallog.h"

#include <QAbstractItemModelTester>
#include <QtTest>

using Tester = QAbstractItemModelTester;
using Strings = QSet<QString>;

namespace {

QStringList words(const QString &text) { return text.split(QLatin1Char(' '), Qt::SkipEmptyParts); }

Strings set(const QString &text)
{
    const QStringList list = words(text);
    return Strings(list.cbegin(), list.cend());
}

// The rows of a check model as "a b* c-": * ticked, - without check box.
QString ticks(const QAbstractItemModel &model)
{
    QStringList rows;
    for (int row = 0; row < model.rowCount(); ++row) {
        const QVariant state = model.index(row, 0).data(Qt::CheckStateRole);
        rows.append(model.index(row, 0).data().toString()
                    + (!state.isValid() ? "-" : state.toInt() == Qt::Checked ? "*" : ""));
    }
    return rows.join(QLatin1Char(' '));
}

const QStringList resetSignals{"aboutToReset", "reset"};

} // namespace

class CheckModelsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void clicks_data()
    {
        QTest::addColumn<QString>("load"); // "+x y" ticks x and y, "-x y" all but x and y, "" none
        QTest::addColumn<QString>("clicks"); // "+x" ticks row x, "-x" unticks it
        QTest::addColumn<QString>("accepted");
        QTest::addColumn<QString>("ticked");
        QTest::addColumn<QString>("add");
        QTest::addColumn<QString>("remove");

        QTest::newRow("ticked from the set") << "+b" << "-b +c" << "11" << "a b c* d" << "c" << "b";
        QTest::newRow("ticked outside the set") << "-b" << "-a +b" << "11" << "a b* c* d*" << "b" << "a";
        QTest::newRow("strings missing from the list are ignored") << "+x c" << "" << "" << "a b c* d" << "" << "";
        QTest::newRow("tick back what was unticked") << "+b" << "-b +c +b" << "111" << "a b* c* d" << "c" << "";
        QTest::newRow("tick then untick leaves nothing") << "" << "+a -a" << "11" << "a b c d" << "" << "";
        QTest::newRow("current state is refused") << "+a" << "+a -b -a" << "001" << "a b c d" << "" << "a";
    }

    void clicks()
    {
        QFETCH(QString, load);
        QFETCH(QString, clicks);
        QFETCH(QString, accepted);
        QFETCH(QString, add);
        QFETCH(QString, remove);

        // Without incompatible pairs both models keep the same record of changes.
        CheckMiscModel plain;
        ConfigureCheckModel configure;
        for (CheckMiscModel *model : {&plain, static_cast<CheckMiscModel *>(&configure)}) {
            Tester tester(model, Tester::FailureReportingMode::QtTest);
            const QStringList list = words(QStringLiteral("a b c d"));
            model->setDataChecked(list, set(QStringLiteral("a")));
            model->setData(model->index(0, 0), Qt::Unchecked, Qt::CheckStateRole);
            SignalLog log;
            log.watchModel(model);
            // Every load is one reset, even of the same strings, and forgets the clicks.
            if (load.isEmpty())
                model->setData(list);
            else if (load.startsWith(QLatin1Char('+')))
                model->setDataChecked(list, set(load.mid(1)));
            else
                model->setDataUnchecked(list, set(load.mid(1)));
            QCOMPARE(log.take(), resetSignals);
            QVERIFY(model->dataToAdd().isEmpty() && model->dataToRemove().isEmpty());

            QString results;
            for (const QString &click : words(clicks)) {
                const QModelIndex index = model->index(list.indexOf(click.mid(1)), 0);
                const int state = click.startsWith(QLatin1Char('+')) ? Qt::Checked : Qt::Unchecked;
                results += model->setData(index, state, Qt::CheckStateRole) ? '1' : '0';
            }
            QCOMPARE(results, accepted);
            QCOMPARE(log.entries.size(), accepted.count(QLatin1Char('1'))); // a refused click is silent
            QTEST(ticks(*model), "ticked");
            QCOMPARE(model->dataToAdd(), set(add));
            QCOMPARE(model->dataToRemove(), set(remove));
        }
    }

    void miscModelSetData()
    {
        // MiscModel::setData() resets only when the list changes, a new order
        // included, and does not know of the ticks: the rows it adds are not
        // ticked, and can be ticked like any other.
        CheckMiscModel model;
        Tester tester(&model, Tester::FailureReportingMode::QtTest);
        model.setDataChecked(words(QStringLiteral("a b")), {"a"});
        QVERIFY(!model.setData(model.index(1, 0), Qt::Checked, Qt::DisplayRole));
        SignalLog log;
        log.watchModel(&model);
        MiscModel &misc = model;
        for (const char *list : {"a b", "b a", "a b c"})
            misc.setData(words(QLatin1String(list)));
        QCOMPARE(log.take(), resetSignals + resetSignals);
        QCOMPARE(model.index(1, 0).data(Qt::ToolTipRole).toString(), QStringLiteral("b"));
        QVERIFY(model.setData(model.index(2, 0), Qt::Checked, Qt::CheckStateRole));
        QCOMPARE(ticks(model), QStringLiteral("a* b c*"));
        model.clear();
        QVERIFY(model.dataToAdd().isEmpty() && model.checkedData().isEmpty());
    }

    void tickedRowDisablesIncompatibleRows()
    {
        ConfigureCheckModel model;
        Tester tester(&model, Tester::FailureReportingMode::QtTest);
        model.setData(words(QStringLiteral("a b c")));
        SignalLog log;
        log.watchModel(&model);
        model.setInCmpatibleModes({0 * 3 + 1});
        model.setInCmpatibleModes({0 * 3 + 1});
        QCOMPARE(log.take(), resetSignals);
        const QModelIndex a = model.index(0, 0);
        const QModelIndex b = model.index(1, 0);
        // The pair is the key min * rows + max.
        QVERIFY(!model.checkCompatible(0, 1) && !model.checkCompatible(1, 0) && model.checkCompatible(0, 2));
        const Qt::ItemFlags checkable = model.flags(b);

        // Ticking a row can disable others: the whole column is announced.
        QVERIFY(model.setData(a, Qt::Checked, Qt::CheckStateRole));
        QCOMPARE(log.take(), QStringList{"changed(a:0, c:0)"});
        QCOMPARE(ticks(model), QStringLiteral("a* b- c"));
        QCOMPARE(model.flags(b), checkable & ~(Qt::ItemIsUserCheckable | Qt::ItemIsEnabled));
        // Views offer no check box there, but the model itself takes the tick
        // as a plain check model would, with its bookkeeping.
        QVERIFY(model.setData(b, Qt::Checked, Qt::CheckStateRole));
        QCOMPARE(log.take(), QStringList{"changed(a:0, c:0)"});
        QCOMPARE(ticks(model), QStringLiteral("a- b- c"));
        QCOMPARE(model.dataToAdd(), set(QStringLiteral("a b")));

        // A list loaded with both rows of a pair ticked can still be mended.
        model.setDataChecked(words(QStringLiteral("a b c")), {"a", "b"});
        QCOMPARE(ticks(model), QStringLiteral("a- b- c"));
        QVERIFY(model.setData(b, Qt::Unchecked, Qt::CheckStateRole));
        QCOMPARE(ticks(model), QStringLiteral("a* b- c"));
        QCOMPARE(model.dataToRemove(), set(QStringLiteral("b")));

        // The key is made with the row count: with four rows 1 * 4 + 3 names rows 1 and 3.
        model.setData(words(QStringLiteral("a b c d")));
        model.setInCmpatibleModes({1 * 4 + 3});
        QVERIFY(!model.checkCompatible(3, 1) && model.checkCompatible(0, 1));
    }
};

QTEST_GUILESS_MAIN(CheckModelsTest)
#include "tst_checkmodels.moc"
