#include <kvt-common/checkmiscmodel.h>
#include <kvt-common/configurecheckmodel.h>
#include <kvt-common/miscmodel.h>

#include "signallog.h"

#include <QAbstractItemModelTester>
#include <QRandomGenerator>
#include <QStandardItemModel>
#include <QtTest>

using Tester = QAbstractItemModelTester;
using Strings = QSet<QString>;

namespace {

QStringList words(const QString &text)
{
    return text.split(QLatin1Char(' '), Qt::SkipEmptyParts);
}

Strings set(const QString &text)
{
    const QStringList list = words(text);
    return Strings(list.cbegin(), list.cend());
}

QString sorted(const Strings &strings)
{
    QStringList list = strings.values();
    list.sort();
    return list.join(QLatin1Char(' '));
}

// The rows of a check model as "a b* c-": * ticked, - without check box.
QString ticks(const QAbstractItemModel &model)
{
    QStringList rows;
    for (int row = 0; row < model.rowCount(); ++row) {
        const QModelIndex index = model.index(row, 0);
        const QVariant state = index.data(Qt::CheckStateRole);
        QString text = index.data().toString();
        if (!state.isValid())
            text += QLatin1Char('-');
        else if (state.toInt() == Qt::Checked)
            text += QLatin1Char('*');
        rows.append(text);
    }
    return rows.join(QLatin1Char(' '));
}

} // namespace

class CheckModelsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void miscModel();
    void loading_data();
    void loading();
    void clicks_data();
    void clicks();
    void clicksAreAlwaysTheNetDifference();
    void refusedClicks_data();
    void refusedClicks();
    void clickSignals();
    void stringsReplacedThroughTheBase();
    void clearing();
    void checkCompatible_data();
    void checkCompatible();
    void tickedRowDisablesIncompatibleRows();
    void pairKeysUseTheRowCount();
    void descriptionsAndSettings();
};

void CheckModelsTest::miscModel()
{
    MiscModel model;
    Tester tester(&model, Tester::FailureReportingMode::QtTest);
    SignalLog log;
    log.watchModel(&model);

    model.setData(QList<QString>{"one", "two"});
    QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
    model.setData(QList<QString>{"one", "two"});
    QVERIFY(log.entries.isEmpty());
    QCOMPARE(model.data(), (QList<QString>{"one", "two"}));

    QCOMPARE(model.rowCount(), 2);
    QCOMPARE(model.columnCount(), 1);
    const QModelIndex two = model.index(1, 0);
    QCOMPARE(model.rowCount(two), 0);
    QCOMPARE(model.columnCount(two), 0);
    QCOMPARE(two.data(Qt::DisplayRole).toString(), QStringLiteral("two"));
    QCOMPARE(two.data(Qt::ToolTipRole).toString(), QStringLiteral("two"));
    QVERIFY(!two.data(Qt::EditRole).isValid());
    QVERIFY(!two.data(Qt::CheckStateRole).isValid());
    QCOMPARE(int(model.flags(two)), 161);
    QCOMPARE(model.flags(QModelIndex()), Qt::NoItemFlags);
    QCOMPARE(model.headerData(0, Qt::Horizontal).toString(), QStringLiteral("Data"));
    QVERIFY(!model.headerData(1, Qt::Horizontal).isValid());
    QVERIFY(!model.headerData(0, Qt::Vertical).isValid());
    QVERIFY(!model.headerData(0, Qt::Horizontal, Qt::ToolTipRole).isValid());

    model.setData(QList<QString>{"two", "one"}); // same strings, other order
    QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
    model.clear();
    QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
    QCOMPARE(model.rowCount(), 0);
}

void CheckModelsTest::loading_data()
{
    QTest::addColumn<QString>("how");
    QTest::addColumn<QString>("set");
    QTest::addColumn<QString>("expected");

    QTest::newRow("plain list") << "plain" << "" << "a b c";
    QTest::newRow("ticked from the set") << "checked" << "b" << "a b* c";
    QTest::newRow("ticked outside the set") << "unchecked" << "b" << "a* b c*";
    QTest::newRow("strings missing from the list are ignored") << "checked" << "x c" << "a b c*";
}

void CheckModelsTest::loading()
{
    QFETCH(QString, how);
    QFETCH(QString, set);
    QFETCH(QString, expected);

    CheckMiscModel model;
    Tester tester(&model, Tester::FailureReportingMode::QtTest);
    model.setDataChecked(words(QStringLiteral("a b c")), {"a", "b", "c"});
    model.setData(model.index(0, 0), Qt::Unchecked, Qt::CheckStateRole);
    SignalLog log;
    log.watchModel(&model);

    const QStringList list = words(QStringLiteral("a b c"));
    if (how == QLatin1String("plain"))
        model.setData(list);
    else if (how == QLatin1String("checked"))
        model.setDataChecked(list, ::set(set));
    else
        model.setDataUnchecked(list, ::set(set));

    // Every load is one reset, even of the same strings, and forgets the clicks.
    QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
    QCOMPARE(ticks(model), expected);
    QVERIFY(model.dataToAdd().isEmpty());
    QVERIFY(model.dataToRemove().isEmpty());
    QStringList tickedRows;
    for (const QString &row : words(expected)) {
        if (row.endsWith(QLatin1Char('*')))
            tickedRows.append(row.chopped(1));
    }
    QCOMPARE(sorted(model.checkedData()), tickedRows.join(QLatin1Char(' ')));
}

void CheckModelsTest::clicks_data()
{
    QTest::addColumn<QString>("ticked"); // ticked at load
    QTest::addColumn<QString>("clicks"); // "+x" ticks row x, "-x" unticks it
    QTest::addColumn<QString>("accepted");
    QTest::addColumn<QString>("add");
    QTest::addColumn<QString>("remove");

    QTest::newRow("untick one, tick another") << "b" << "-b +c" << "11" << "c" << "b";
    QTest::newRow("tick back what was unticked") << "b" << "-b +c +b" << "111" << "c" << "";
    QTest::newRow("untick what was ticked") << "" << "+a -a" << "11" << "" << "";
    QTest::newRow("current state is refused") << "a" << "+a -b -a" << "001" << "" << "a";
    QTest::newRow("everything turned around") << "a b" << "-a -b +c +d" << "1111" << "c d" << "a b";
}

void CheckModelsTest::clicks()
{
    QFETCH(QString, ticked);
    QFETCH(QString, clicks);
    QFETCH(QString, accepted);
    QFETCH(QString, add);
    QFETCH(QString, remove);

    CheckMiscModel model;
    Tester tester(&model, Tester::FailureReportingMode::QtTest);
    const QStringList list = words(QStringLiteral("a b c d"));
    model.setDataChecked(list, set(ticked));
    QString results;
    for (const QString &click : words(clicks)) {
        const QModelIndex index = model.index(list.indexOf(click.mid(1)), 0);
        const int state = click.startsWith(QLatin1Char('+')) ? Qt::Checked : Qt::Unchecked;
        results += model.setData(index, state, Qt::CheckStateRole) ? '1' : '0';
    }
    QCOMPARE(results, accepted);
    QCOMPARE(sorted(model.dataToAdd()), add);
    QCOMPARE(sorted(model.dataToRemove()), remove);
}

void CheckModelsTest::clicksAreAlwaysTheNetDifference()
{
    ConfigureCheckModel model; // the bookkeeping is the same for both models
    Tester tester(&model, Tester::FailureReportingMode::QtTest);
    const QStringList list = words(QStringLiteral("a b c d e f"));
    const Strings initial = set(QStringLiteral("b e"));
    model.setDataChecked(list, initial);
    model.setInCmpatibleModes({0 * 6 + 1, 2 * 6 + 5});
    QRandomGenerator random(4711);
    for (int i = 0; i < 400; ++i) {
        const QModelIndex index = model.index(random.bounded(list.size()), 0);
        model.setData(index, random.bounded(2) ? Qt::Checked : Qt::Unchecked, Qt::CheckStateRole);
        const Strings now = model.checkedData();
        QCOMPARE(model.dataToAdd(), Strings(now).subtract(initial));
        QCOMPARE(model.dataToRemove(), Strings(initial).subtract(now));
    }
}

void CheckModelsTest::refusedClicks_data()
{
    QTest::addColumn<int>("row");
    QTest::addColumn<int>("role");
    QTest::addColumn<bool>("foreign");

    QTest::newRow("display role") << 0 << int(Qt::DisplayRole) << false;
    QTest::newRow("edit role") << 0 << int(Qt::EditRole) << false;
    QTest::newRow("invalid index") << -1 << int(Qt::CheckStateRole) << false;
    QTest::newRow("index of another model") << 0 << int(Qt::CheckStateRole) << true;
}

void CheckModelsTest::refusedClicks()
{
    QFETCH(int, row);
    QFETCH(int, role);
    QFETCH(bool, foreign);

    CheckMiscModel model;
    Tester tester(&model, Tester::FailureReportingMode::QtTest);
    model.setData(words(QStringLiteral("a b")));
    QStandardItemModel other(2, 1);
    const QModelIndex index = foreign ? other.index(row, 0) : model.index(row, 0);
    SignalLog log;
    log.watchModel(&model);
    QVERIFY(!model.setData(index, Qt::Checked, role));
    QVERIFY(log.entries.isEmpty());
    QVERIFY(model.checkedData().isEmpty());
    QVERIFY(model.dataToAdd().isEmpty());
}

void CheckModelsTest::clickSignals()
{
    CheckMiscModel model;
    Tester tester(&model, Tester::FailureReportingMode::QtTest);
    model.setData(words(QStringLiteral("a b c")));
    SignalLog log;
    log.watchModel(&model);
    // A listener of the change already reads the new record of changes.
    QStringList seen;
    connect(&model, &QAbstractItemModel::dataChanged, this,
            [&] { seen.append(sorted(model.dataToAdd())); });

    const QModelIndex b = model.index(1, 0);
    QVERIFY(model.setData(b, Qt::Checked, Qt::CheckStateRole));
    QVERIFY(!model.setData(b, Qt::Checked, Qt::CheckStateRole));
    QCOMPARE(log.take(), QStringList{"changed(b:0, b:0)"});
    QCOMPARE(seen, QStringList{"b"});
    QCOMPARE(b.data(Qt::CheckStateRole).toInt(), int(Qt::Checked));
    QCOMPARE(int(model.flags(b)), 161 | Qt::ItemIsUserCheckable);
    QCOMPARE(model.flags(QModelIndex()), Qt::NoItemFlags);
    QVERIFY(!b.data(Qt::UserRole).isValid());
}

void CheckModelsTest::stringsReplacedThroughTheBase()
{
    // MiscModel::setData() does not know of the ticks; the rows it adds are
    // simply not ticked, and can be ticked like any other.
    CheckMiscModel model;
    Tester tester(&model, Tester::FailureReportingMode::QtTest);
    model.setDataChecked(words(QStringLiteral("a")), {"a"});
    static_cast<MiscModel &>(model).setData(words(QStringLiteral("a b c")));
    QCOMPARE(ticks(model), QStringLiteral("a* b c"));
    QVERIFY(model.setData(model.index(2, 0), Qt::Checked, Qt::CheckStateRole));
    QCOMPARE(ticks(model), QStringLiteral("a* b c*"));
    QCOMPARE(sorted(model.uncheckedData()), QStringLiteral("b"));
}

void CheckModelsTest::clearing()
{
    CheckMiscModel model;
    Tester tester(&model, Tester::FailureReportingMode::QtTest);
    SignalLog log;
    log.watchModel(&model);
    model.clear();
    QVERIFY(log.entries.isEmpty());

    model.setDataChecked(words(QStringLiteral("a b")), {"a"});
    model.setData(model.index(1, 0), Qt::Checked, Qt::CheckStateRole);
    log.take();
    model.clear();
    QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
    QCOMPARE(model.rowCount(), 0);
    QVERIFY(model.dataToAdd().isEmpty());
    QVERIFY(model.checkedData().isEmpty());

    // A row loaded afterwards starts unticked.
    static_cast<MiscModel &>(model).setData(words(QStringLiteral("a")));
    QCOMPARE(ticks(model), QStringLiteral("a"));
}

void CheckModelsTest::checkCompatible_data()
{
    QTest::addColumn<int>("a");
    QTest::addColumn<int>("b");
    QTest::addColumn<bool>("compatible");

    // Three rows; the pair (0, 1) excludes itself.
    QTest::newRow("incompatible pair") << 0 << 1 << false;
    QTest::newRow("in either order") << 1 << 0 << false;
    QTest::newRow("other pair") << 0 << 2 << true;
    QTest::newRow("a row with itself") << 2 << 2 << true;
    QTest::newRow("row outside the list") << 0 << 5 << false;
    QTest::newRow("the row count itself") << 3 << 3 << false;
    QTest::newRow("negative row") << -1 << 0 << false;
}

void CheckModelsTest::checkCompatible()
{
    QFETCH(int, a);
    QFETCH(int, b);
    QFETCH(bool, compatible);

    ConfigureCheckModel model;
    model.setData(words(QStringLiteral("x y z")));
    model.setInCmpatibleModes({1});
    QCOMPARE(model.checkCompatible(a, b), compatible);
}

void CheckModelsTest::tickedRowDisablesIncompatibleRows()
{
    ConfigureCheckModel model;
    Tester tester(&model, Tester::FailureReportingMode::QtTest);
    model.setData(words(QStringLiteral("a b c")));
    model.setInCmpatibleModes({0 * 3 + 1});
    SignalLog log;
    log.watchModel(&model);
    const QModelIndex a = model.index(0, 0);
    const QModelIndex b = model.index(1, 0);
    const QModelIndex c = model.index(2, 0);
    const Qt::ItemFlags checkable = model.flags(b);
    QVERIFY(checkable & Qt::ItemIsUserCheckable);

    QVERIFY(model.setData(a, Qt::Checked, Qt::CheckStateRole));
    QCOMPARE(log.take(), QStringList{"changed(a:0, c:0)"});
    QCOMPARE(ticks(model), QStringLiteral("a* b- c"));
    QCOMPARE(model.flags(b), checkable & ~(Qt::ItemIsUserCheckable | Qt::ItemIsEnabled));
    QCOMPARE(model.flags(c), checkable);
    QCOMPARE(model.flags(a), checkable);

    // The disabled row cannot be ticked behind the view's back either.
    QVERIFY(!model.setData(b, Qt::Checked, Qt::CheckStateRole));
    QVERIFY(log.entries.isEmpty());
    QVERIFY(model.setData(c, Qt::Checked, Qt::CheckStateRole));
    QVERIFY(model.setData(a, Qt::Unchecked, Qt::CheckStateRole));
    QCOMPARE(log.take(), (QStringList{"changed(a:0, c:0)", "changed(a:0, c:0)"}));
    QCOMPARE(ticks(model), QStringLiteral("a b c*"));
    QCOMPARE(model.flags(b), checkable);

    // A list loaded with both rows of a pair ticked can still be mended.
    model.setDataChecked(words(QStringLiteral("a b c")), {"a", "b"});
    QCOMPARE(ticks(model), QStringLiteral("a- b- c"));
    QVERIFY(model.setData(b, Qt::Unchecked, Qt::CheckStateRole));
    QCOMPARE(ticks(model), QStringLiteral("a* b- c"));
    QCOMPARE(sorted(model.dataToRemove()), QStringLiteral("b"));
}

void CheckModelsTest::pairKeysUseTheRowCount()
{
    ConfigureCheckModel model;
    Tester tester(&model, Tester::FailureReportingMode::QtTest);
    model.setData(words(QStringLiteral("a b c d")));
    model.setInCmpatibleModes({1 * 4 + 3}); // b and d
    model.setData(model.index(3, 0), Qt::Checked, Qt::CheckStateRole);
    QCOMPARE(ticks(model), QStringLiteral("a b- c d*"));
    // With three rows the same key names no pair at all.
    model.setDataChecked(words(QStringLiteral("a b c")), {"b"});
    QCOMPARE(ticks(model), QStringLiteral("a b* c"));
}

void CheckModelsTest::descriptionsAndSettings()
{
    ConfigureCheckModel model;
    Tester tester(&model, Tester::FailureReportingMode::QtTest);
    model.setData(words(QStringLiteral("a b")));
    model.setDescriptions({QStringLiteral("first mode")});
    QCOMPARE(model.index(0, 0).data(Qt::UserRole).toString(), QStringLiteral("first mode"));
    QVERIFY(!model.index(1, 0).data(Qt::UserRole).isValid());
    QVERIFY(!model.index(0, 0).data(Qt::EditRole).isValid());
    QCOMPARE(model.index(0, 0).data(Qt::ToolTipRole).toString(), QStringLiteral("a"));
    QCOMPARE(model.descriptions(), QStringList{"first mode"});

    SignalLog log;
    log.watchModel(&model);
    model.setInCmpatibleModes({1});
    QCOMPARE(log.take(), (QStringList{"aboutToReset", "reset"}));
    model.setInCmpatibleModes({1});
    QVERIFY(log.entries.isEmpty());
    QCOMPARE(model.inCmpatibleModes(), QSet<int>{1});
}

QTEST_GUILESS_MAIN(CheckModelsTest)
#include "tst_checkmodels.moc"
