// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

#include <kvt-common/record.h>
#include <kvt-common/recordmodel.h>
#include <kvt-common/recordsortfilterproxymodel.h>

#include "signallog.h"

#include <QAbstractItemModelTester>
#include <QtTest>

#include <memory>

using Tester = QAbstractItemModelTester;

namespace {

int liveRecords = 0;

// A host entry: name, address and a comment column that cannot be edited;
// valid when it has both a name and an address. "_" names an empty one.
struct HostRecord : Record {
    explicit HostRecord(const QString &name = {}, const QString &address = {}) : name(name), address(address) { ++liveRecords; }
    ~HostRecord() override { --liveRecords; }
    bool isEmpty() const override { return name.isEmpty() && address.isEmpty(); }
    bool isValid() const override { return !name.isEmpty() && !address.isEmpty(); }
    bool isEditable(int column) const override { return column < 2; }
    QVariant data(int column, int role) const override
    {
        const QStringList cells{name, address, name.isEmpty() ? QString() : QStringLiteral("host ") + name};
        return role == Qt::DisplayRole || role == Qt::EditRole ? QVariant(cells.value(column)) : QVariant();
    }
    bool setData(int column, const QVariant &value) override
    {
        // An address is made of digits and dots; the comment is not edited.
        if (column > 1 || (column == 1 && value.toString().contains(QRegularExpression(QStringLiteral("[^0-9.]")))))
            return false;
        (column == 0 ? name : address) = value.toString();
        setChanged();
        return true;
    }
    QString name, address;
};

// "a b _": records named a and b (address 10.0.0.n) and an empty one.
QList<Record *> records(const QString &description)
{
    QList<Record *> result;
    for (const QString &name : description.split(QLatin1Char(' '), Qt::SkipEmptyParts))
        result.append(name == QLatin1String("_") ? new HostRecord
                                                 : new HostRecord(name, QStringLiteral("10.0.0.%1").arg(result.size() + 1)));
    return result;
}

// The table as "a b _", by the names in column 0.
QString rows(const QAbstractItemModel &model)
{
    QStringList result;
    for (int row = 0; row < model.rowCount(); ++row)
        result.append(model.index(row, 0).data().toString());
    return result.replaceInStrings(QRegularExpression(QStringLiteral("^$")), QStringLiteral("_")).join(QLatin1Char(' '));
}

const QStringList resetSignals{"aboutToReset", "reset"};

} // namespace

class RecordsTest : public QObject
{
    Q_OBJECT

    std::unique_ptr<RecordModel> model;
    std::unique_ptr<Tester> tester;
    SignalLog *log = nullptr;

private Q_SLOTS:
    void init()
    {
        // No bounds check in the header function: the model must not ask beyond the columns.
        model.reset(new RecordModel([] { return 3; }, [](int section) -> QVariant { return QStringLiteral("NAC").at(section); },
                                    []() -> Record * { return new HostRecord; }));
        tester.reset(new Tester(model.get(), Tester::FailureReportingMode::QtTest));
        (log = new SignalLog(model.get()))->watchModel(model.get());
    }
    void cleanup()
    {
        tester.reset();
        model.reset();
        QCOMPARE(liveRecords, 0);
    }

    void ownership()
    {
        model->setRecordList(records(QStringLiteral("a b")));
        model->setRecordList(records(QStringLiteral("c d")));
        QCOMPARE(liveRecords, 2);
        model->clear();
        QCOMPARE(liveRecords, 0);
        QCOMPARE(log->take(), resetSignals + resetSignals + resetSignals);
        // A record given back with the model's own list stays alive, and is held once.
        model->setRecordList(records(QStringLiteral("f g")));
        const QList<Record *> own = model->getRecordList();
        model->setRecordList({own.at(1), own.at(1), nullptr});
        model->appendRecordList({own.at(1), nullptr});
        QVERIFY(rows(*model) == QStringLiteral("g") && liveRecords == 1); // cleanup() checks that the destructor deletes it
    }

    void rowEdits_data()
    {
        QTest::addColumn<QString>("table");
        QTest::addColumn<QString>("edit"); // "+row,count" inserts rows, "-row,count" removes them, else appends
        QTest::addColumn<QString>("expected"); // the same table when the edit is refused
        QTest::newRow("insert in the middle") << "a b" << "+1,2" << "a _ _ b";
        QTest::newRow("remove in the middle") << "a b c d" << "-1,2" << "a d";
        QTest::newRow("append below the last filled row") << "a _ _" << "x y" << "a x y _ _";
    }
    void rowEdits()
    {
        QFETCH(QString, table);
        QFETCH(QString, edit);
        QFETCH(QString, expected);
        model->setRecordList(records(table));
        const int row = edit.mid(1).section(QLatin1Char(','), 0, 0).toInt(), count = edit.section(QLatin1Char(','), 1).toInt();
        const bool accepted = edit[0] == '+' ? model->insertRows(row, count)
                            : edit[0] == '-' ? model->removeRows(row, count)
                                             : (model->appendRecordList(records(edit)), true);
        QCOMPARE(accepted, expected != table);
        QCOMPARE(rows(*model), expected);
        QCOMPARE(liveRecords, model->rowCount()); // removed rows are deleted, and only those
    }

    void editing()
    {
        model->setRecordList(records(QStringLiteral("a b")));
        log->take();
        const QModelIndex address = model->index(1, 1);
        QVERIFY(model->allRecordsValid() && model->setData(address, QStringLiteral("192.168.1.1")));
        // The whole row is announced: one cell may change how the others look.
        QCOMPARE(log->take(), QStringList{"changed(b:0, b:2)"});
        // Refused by the record, silently.
        QVERIFY(!model->setData(address, QStringLiteral("not an address")));
        QVERIFY(log->entries.isEmpty());
        QVERIFY(model->insertRows(2, 1) && !model->allRecordsValid());
        // Disabling resets the model once and makes every cell read-only.
        model->setEnabled(false);
        model->setEnabled(false);
        QCOMPARE(log->take().mid(2), resetSignals);
        QVERIFY(!(model->flags(address) & Qt::ItemIsEditable));
        QCOMPARE(model->headerData(0, Qt::Vertical).toInt(), 1); // rows count from 1
        QVERIFY(!model->headerData(-1, Qt::Horizontal).isValid() && !model->headerData(3, Qt::Horizontal).isValid());
    }

    void filter()
    {
        // The pattern is searched in every column, whatever the key column.
        model->setRecordList(records(QStringLiteral("a bb c"))); // at 10.0.0.1 to 10.0.0.3
        RecordSortFilterProxyModel proxy;
        proxy.setSourceModel(model.get());
        Tester proxyTester(&proxy, Tester::FailureReportingMode::QtTest);
        proxy.setFilterKeyColumn(0);
        proxy.setFilterRegExp(QRegExp(QStringLiteral("0\\.1$|host c")));
        QCOMPARE(rows(proxy), QStringLiteral("a c"));
    }
};

QTEST_GUILESS_MAIN(RecordsTest)
#include "tst_records.moc"
