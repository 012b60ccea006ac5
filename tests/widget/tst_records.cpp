#include <kvt-common/record.h>
#include <kvt-common/recordmodel.h>
#include <kvt-common/recordsortfilterproxymodel.h>

#include "signallog.h"

#include <QAbstractItemModelTester>
#include <QtTest>

#include <memory>

using Tester = QAbstractItemModelTester;

namespace {

QStringList destroyedRecords; // names of records as they are destroyed
int liveRecords = 0;

/*
 * A host entry: name, address and a comment column that cannot be edited.
 * "_" in a table description stands for an empty record; a record is valid
 * when it has both a name and an address.
 */
class HostRecord : public Record
{
public:
    explicit HostRecord(const QString &name = QString(), const QString &address = QString())
        : name(name)
        , address(address)
    {
        ++liveRecords;
    }
    ~HostRecord() override
    {
        --liveRecords;
        destroyedRecords.append(name.isEmpty() ? QStringLiteral("_") : name);
    }

    bool isEmpty() const override { return name.isEmpty() && address.isEmpty(); }
    bool isValid() const override { return !name.isEmpty() && !address.isEmpty(); }
    bool isEditable(int column) const override { return column < 2; }
    QVariant data(int column, int role) const override
    {
        if (role != Qt::DisplayRole && role != Qt::EditRole)
            return QVariant();
        switch (column) {
        case 0:
            return name;
        case 1:
            return address;
        case 2:
            return name.isEmpty() ? QString() : QStringLiteral("host %1").arg(name);
        default:
            return QVariant();
        }
    }
    bool setData(int column, const QVariant &value) override
    {
        const QString text = value.toString();
        // An address is made of digits and dots.
        if (column == 1 && !text.contains(QRegularExpression(QStringLiteral("^[0-9.]*$"))))
            return false;
        if (column == 0)
            name = text;
        else if (column == 1)
            address = text;
        else
            return false;
        setChanged();
        return true;
    }

    QString name;
    QString address;
};

int threeColumns()
{
    return 3;
}

QVariant hostHeader(int section)
{
    static const char *const names[] = {"Name", "Address", "Comment"};
    return QString::fromLatin1(names[section]); // no bounds check: the model must not ask
}

Record *newHost()
{
    return new HostRecord;
}

Record *brokenFactory()
{
    return nullptr;
}

// "a b _": records named a and b (address 10.0.0.n) and an empty one.
QList<Record *> records(const QString &description)
{
    QList<Record *> result;
    int n = 0;
    for (const QString &name : description.split(QLatin1Char(' '), Qt::SkipEmptyParts)) {
        ++n;
        if (name == QLatin1String("_"))
            result.append(new HostRecord);
        else
            result.append(new HostRecord(name, QStringLiteral("10.0.0.%1").arg(n)));
    }
    return result;
}

// The table as "a b _", by the names in column 0.
QString rows(const QAbstractItemModel &model)
{
    QStringList result;
    for (int row = 0; row < model.rowCount(); ++row) {
        const QString name = model.index(row, 0).data().toString();
        result.append(name.isEmpty() ? QStringLiteral("_") : name);
    }
    return result.join(QLatin1Char(' '));
}

} // namespace

class RecordsTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void init();
    void cleanup();

    void ownershipInEveryPath();
    void recordsHandedOverTwice();
    void insertRows_data();
    void insertRows();
    void removeRows_data();
    void removeRows();
    void appendKeepsEmptyRowsAtTheBottom_data();
    void appendKeepsEmptyRowsAtTheBottom();
    void allRecordsValid_data();
    void allRecordsValid();
    void editing();
    void enabling();
    void headers();
    void withoutFunctions();
    void filter_data();
    void filter();
    void filterEdgeCases();

private:
    std::unique_ptr<RecordModel> model;
    std::unique_ptr<Tester> tester;
    SignalLog *log = nullptr;
};

void RecordsTest::init()
{
    destroyedRecords.clear();
    model.reset(new RecordModel(threeColumns, hostHeader, newHost));
    tester.reset(new Tester(model.get(), Tester::FailureReportingMode::QtTest));
    log = new SignalLog(model.get());
    log->watchModel(model.get());
}

void RecordsTest::cleanup()
{
    tester.reset();
    model.reset();
    QCOMPARE(liveRecords, 0);
}

void RecordsTest::ownershipInEveryPath()
{
    const QStringList reset{"aboutToReset", "reset"};
    model->setRecordList(records(QStringLiteral("a b c")));
    QCOMPARE(log->take(), reset);
    QCOMPARE(rows(*model), QStringLiteral("a b c"));

    model->setRecordList(records(QStringLiteral("d e")));
    QCOMPARE(log->take(), reset);
    QCOMPARE(destroyedRecords, (QStringList{"a", "b", "c"}));
    destroyedRecords.clear();

    model->appendRecordList(records(QStringLiteral("f")));
    QVERIFY(model->removeRows(0, 2));
    QCOMPARE(destroyedRecords, (QStringList{"d", "e"}));
    QCOMPARE(rows(*model), QStringLiteral("f"));
    destroyedRecords.clear();
    log->take();

    // Taken records belong to the caller: the model deletes none of them.
    QList<Record *> taken = model->takeRecordList();
    QCOMPARE(log->take(), reset);
    QCOMPARE(taken.size(), 1);
    QCOMPARE(model->rowCount(), 0);
    model->clear();
    model->setRecordList(records(QStringLiteral("g")));
    QVERIFY(destroyedRecords.isEmpty());
    qDeleteAll(taken);
    destroyedRecords.clear();

    QVERIFY(model->insertRows(1, 2));
    log->take();
    model->clear();
    QCOMPARE(log->take(), reset);
    QCOMPARE(destroyedRecords, (QStringList{"g", "_", "_"}));
    destroyedRecords.clear();

    // Inside a reset of the caller's own, the list is emptied silently.
    model->appendRecordList(records(QStringLiteral("h i")));
    log->take();
    model->clearRecordList();
    QVERIFY(log->entries.isEmpty());
    QCOMPARE(destroyedRecords, (QStringList{"h", "i"}));
    QCOMPARE(model->rowCount(), 0);
    destroyedRecords.clear();

    model->appendRecordList(records(QStringLiteral("j k")));
    tester.reset();
    model.reset();
    QCOMPARE(destroyedRecords, (QStringList{"j", "k"}));
}

void RecordsTest::recordsHandedOverTwice()
{
    model->setRecordList(records(QStringLiteral("a b")));
    QList<Record *> held = model->getRecordList();

    // The model's own records given back with a new one: only the one left
    // out is deleted, and no record is held twice.
    const QList<Record *> more = records(QStringLiteral("c"));
    model->setRecordList(QList<Record *>{held.at(1), more.at(0), held.at(1), nullptr});
    QCOMPARE(destroyedRecords, QStringList{"a"});
    QCOMPARE(rows(*model), QStringLiteral("b c"));

    // Appending a record already held, twice the same, or null adds it once.
    const QList<Record *> d = records(QStringLiteral("d"));
    log->take();
    model->appendRecordList({held.at(1), d.at(0), d.at(0), nullptr});
    QCOMPARE(rows(*model), QStringLiteral("b c d"));
    QCOMPARE(log->take(), (QStringList{"aboutToInsert(root, 2, 2)", "inserted(root, 2, 2)"}));
    model->appendRecordList({nullptr, held.at(1)});
    model->appendRecordList({});
    QVERIFY(log->entries.isEmpty());
    // cleanup() checks that each record is deleted exactly once.
}

void RecordsTest::insertRows_data()
{
    QTest::addColumn<QString>("table");
    QTest::addColumn<int>("row");
    QTest::addColumn<int>("count");
    QTest::addColumn<bool>("accepted");
    QTest::addColumn<QString>("expected");

    QTest::newRow("append at the end") << "a b" << 2 << 1 << true << "a b _";
    QTest::newRow("insert in the middle") << "a b" << 1 << 2 << true << "a _ _ b";
    QTest::newRow("into an empty table") << "" << 0 << 1 << true << "_";
    QTest::newRow("past the end") << "a b" << 3 << 1 << false << "a b";
    QTest::newRow("negative row") << "a b" << -1 << 1 << false << "a b";
    QTest::newRow("no rows") << "a b" << 1 << 0 << false << "a b";
}

void RecordsTest::insertRows()
{
    QFETCH(QString, table);
    QFETCH(int, row);
    QFETCH(int, count);
    QFETCH(bool, accepted);
    QFETCH(QString, expected);

    model->setRecordList(records(table));
    log->take();
    QCOMPARE(model->insertRows(row, count), accepted);
    QCOMPARE(rows(*model), expected);
    if (accepted) {
        const QString range = QStringLiteral("(root, %1, %2)").arg(row).arg(row + count - 1);
        QCOMPARE(log->take(), (QStringList{"aboutToInsert" + range, "inserted" + range}));
    } else {
        QVERIFY(log->entries.isEmpty());
    }
}

void RecordsTest::removeRows_data()
{
    QTest::addColumn<QString>("table");
    QTest::addColumn<int>("row");
    QTest::addColumn<int>("count");
    QTest::addColumn<bool>("accepted");
    QTest::addColumn<QString>("expected");

    QTest::newRow("one row") << "a b c" << 1 << 1 << true << "a c";
    QTest::newRow("up to the end") << "a b c" << 1 << 2 << true << "a";
    QTest::newRow("everything") << "a b c" << 0 << 3 << true << "";
    QTest::newRow("more than there is") << "a" << 0 << 2 << false << "a";
    QTest::newRow("negative row") << "a b" << -1 << 1 << false << "a b";
    QTest::newRow("no rows") << "a b" << 0 << 0 << false << "a b";
}

void RecordsTest::removeRows()
{
    QFETCH(QString, table);
    QFETCH(int, row);
    QFETCH(int, count);
    QFETCH(bool, accepted);
    QFETCH(QString, expected);

    model->setRecordList(records(table));
    QCOMPARE(model->removeRows(row, count), accepted);
    QCOMPARE(rows(*model), expected);
    QCOMPARE(destroyedRecords.size(), accepted ? count : 0);
    QCOMPARE(liveRecords, model->rowCount());
}

void RecordsTest::appendKeepsEmptyRowsAtTheBottom_data()
{
    QTest::addColumn<QString>("table");
    QTest::addColumn<QString>("appended");
    QTest::addColumn<QString>("expected");
    QTest::addColumn<int>("first");

    QTest::newRow("below the last filled row") << "a _ _" << "x y" << "a x y _ _" << 1;
    QTest::newRow("all rows empty") << "_ _" << "x" << "x _ _" << 0;
    QTest::newRow("no empty rows") << "a b" << "x" << "a b x" << 2;
    QTest::newRow("empty rows in between stay") << "a _ b _" << "x" << "a _ b x _" << 3;
    QTest::newRow("empty table") << "" << "x y" << "x y" << 0;
}

void RecordsTest::appendKeepsEmptyRowsAtTheBottom()
{
    QFETCH(QString, table);
    QFETCH(QString, appended);
    QFETCH(QString, expected);
    QFETCH(int, first);

    model->setRecordList(records(table));
    log->take();
    const QList<Record *> added = records(appended);
    model->appendRecordList(added);
    QCOMPARE(rows(*model), expected);
    const QString range = QStringLiteral("(root, %1, %2)").arg(first).arg(first + added.size() - 1);
    QCOMPARE(log->take(), (QStringList{"aboutToInsert" + range, "inserted" + range}));
    QVERIFY(destroyedRecords.isEmpty());
}

void RecordsTest::allRecordsValid_data()
{
    QTest::addColumn<QString>("table");
    QTest::addColumn<bool>("valid");

    QTest::newRow("empty table is no valid result") << "" << false;
    QTest::newRow("all valid") << "a b" << true;
    QTest::newRow("an empty row") << "a _" << false;
    QTest::newRow("first row invalid") << "_ a" << false;
}

void RecordsTest::allRecordsValid()
{
    QFETCH(QString, table);
    QFETCH(bool, valid);
    model->setRecordList(records(table));
    QCOMPARE(model->allRecordsValid(), valid);
}

void RecordsTest::editing()
{
    model->setRecordList(records(QStringLiteral("a b")));
    log->take();
    const QModelIndex address = model->index(1, 1);

    QVERIFY(model->setData(address, QStringLiteral("192.168.1.1")));
    QCOMPARE(log->take(), QStringList{"changed(b:0, b:2)"});
    QCOMPARE(address.data().toString(), QStringLiteral("192.168.1.1"));

    // The record refuses; so does the model, silently.
    QVERIFY(!model->setData(address, QStringLiteral("not an address")));
    QVERIFY(!model->setData(model->index(1, 2), QStringLiteral("comment")));
    QVERIFY(!model->setData(address, QStringLiteral("1.1.1.1"), Qt::DisplayRole));
    QVERIFY(!model->setData(QModelIndex(), QStringLiteral("1.1.1.1")));
    QVERIFY(log->entries.isEmpty());

    // A new name changes the comment column too: the whole row is announced.
    QVERIFY(model->setData(model->index(0, 0), QStringLiteral("alpha")));
    QCOMPARE(log->take(), QStringList{"changed(alpha:0, alpha:2)"});
    QCOMPARE(model->index(0, 2).data().toString(), QStringLiteral("host alpha"));

    const QList<Record *> list = model->getRecordList();
    QVERIFY(list.at(0)->isChanged());
    QVERIFY(list.at(1)->isChanged());
    model->unchange();
    QVERIFY(!list.at(0)->isChanged());
    QVERIFY(!list.at(1)->isChanged());
    QVERIFY(log->entries.isEmpty());
}

void RecordsTest::enabling()
{
    model->setRecordList(records(QStringLiteral("a")));
    log->take();
    const QModelIndex name = model->index(0, 0);
    const QModelIndex comment = model->index(0, 2);
    QVERIFY(model->isEnabled());
    QVERIFY(model->flags(name) & Qt::ItemIsEditable);
    QVERIFY(!(model->flags(comment) & Qt::ItemIsEditable));
    QVERIFY(model->flags(comment) & Qt::ItemIsEnabled);

    model->setEnabled(false);
    QCOMPARE(log->take(), (QStringList{"aboutToReset", "reset"}));
    QVERIFY(!model->isEnabled());
    for (int column = 0; column < 3; ++column)
        QVERIFY(!(model->flags(model->index(0, column)) & Qt::ItemIsEditable));
    model->setEnabled(false);
    QVERIFY(log->entries.isEmpty());
    model->setEnabled(true);
    QCOMPARE(log->take(), (QStringList{"aboutToReset", "reset"}));
    QVERIFY(model->flags(model->index(0, 1)) & Qt::ItemIsEditable);
    QCOMPARE(model->flags(QModelIndex()), Qt::NoItemFlags);
}

void RecordsTest::headers()
{
    model->setRecordList(records(QStringLiteral("a b")));
    QCOMPARE(model->headerData(0, Qt::Vertical).toInt(), 1);
    QCOMPARE(model->headerData(1, Qt::Vertical).toInt(), 2);
    QCOMPARE(model->headerData(1, Qt::Horizontal).toString(), QStringLiteral("Address"));
    // Other roles are not the header function's business.
    QVERIFY(!model->headerData(1, Qt::Horizontal, Qt::ToolTipRole).isValid());
    // The header function is never asked beyond the columns it knows.
    QVERIFY(!model->headerData(3, Qt::Horizontal).isValid());
    QVERIFY(!model->headerData(-1, Qt::Horizontal).isValid());
}

void RecordsTest::withoutFunctions()
{
    RecordModel bare(nullptr, nullptr, nullptr);
    Tester bareTester(&bare, Tester::FailureReportingMode::QtTest);
    QVERIFY(!bare.isCreatable());
    QVERIFY(!bare.insertRows(0, 1));
    QCOMPARE(bare.columnCount(), 0);
    bare.setRecordList(records(QStringLiteral("a")));
    QCOMPARE(bare.rowCount(), 1);
    QVERIFY(!bare.index(0, 0).isValid());
    QVERIFY(!bare.headerData(0, Qt::Horizontal).isValid());

    // A factory that fails inserts nothing and leaks nothing.
    RecordModel broken(threeColumns, hostHeader, brokenFactory);
    Tester brokenTester(&broken, Tester::FailureReportingMode::QtTest);
    QVERIFY(broken.isCreatable());
    QVERIFY(!broken.insertRows(0, 2));
    QCOMPARE(broken.rowCount(), 0);
}

void RecordsTest::filter_data()
{
    QTest::addColumn<QString>("pattern");
    QTest::addColumn<QString>("expected");

    // Rows: a 10.0.0.1 "host a", bb 10.0.0.2 "host bb", c 10.0.0.3 "host c".
    QTest::newRow("empty pattern") << "" << "a bb c";
    QTest::newRow("invalid pattern") << "(" << "a bb c";
    QTest::newRow("first column") << "^bb$" << "bb";
    QTest::newRow("second column") << "0\\.3$" << "c";
    QTest::newRow("third column, key column ignored") << "host a" << "a";
    QTest::newRow("no column matches") << "zzz" << "";
}

void RecordsTest::filter()
{
    QFETCH(QString, pattern);
    QFETCH(QString, expected);

    model->setRecordList(records(QStringLiteral("a bb c")));
    RecordSortFilterProxyModel proxy;
    proxy.setSourceModel(model.get());
    Tester proxyTester(&proxy, Tester::FailureReportingMode::QtTest);
    proxy.setFilterKeyColumn(0);
    proxy.setFilterRegExp(QRegExp(pattern));
    QCOMPARE(rows(proxy), expected);

    // Rows inserted and removed through the proxy reach the table.
    if (proxy.rowCount() > 0) {
        QVERIFY(proxy.removeRows(0, 1));
        QCOMPARE(model->rowCount(), 2);
    }
}

void RecordsTest::filterEdgeCases()
{
    RecordSortFilterProxyModel lonely;
    QCOMPARE(lonely.rowCount(), 0);

    // Without columns nothing can match, so a filter hides every row.
    RecordModel noColumns(nullptr, nullptr, newHost);
    noColumns.setRecordList(records(QStringLiteral("a b")));
    RecordSortFilterProxyModel proxy;
    proxy.setSourceModel(&noColumns);
    Tester proxyTester(&proxy, Tester::FailureReportingMode::QtTest);
    proxy.setFilterRegExp(QStringLiteral("a"));
    QCOMPARE(proxy.rowCount(), 0);
    proxy.setFilterRegExp(QString());
    QCOMPARE(proxy.rowCount(), 2);

    // The live table is followed.
    model->setRecordList(records(QStringLiteral("a b")));
    RecordSortFilterProxyModel live;
    live.setSourceModel(model.get());
    Tester liveTester(&live, Tester::FailureReportingMode::QtTest);
    live.setFilterRegExp(QStringLiteral("^a|^c"));
    QCOMPARE(rows(live), QStringLiteral("a"));
    model->appendRecordList(records(QStringLiteral("c bc")));
    QCOMPARE(rows(live), QStringLiteral("a c"));
    QVERIFY(model->setData(model->index(0, 0), QStringLiteral("ba")));
    QCOMPARE(rows(live), QStringLiteral("c"));
    // A row inserted through the proxy goes above the source row shown there.
    QVERIFY(live.insertRows(0, 1));
    QCOMPARE(rows(*model), QStringLiteral("ba b _ c bc"));
}

QTEST_GUILESS_MAIN(RecordsTest)
#include "tst_records.moc"
