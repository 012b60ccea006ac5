// Module::isAdministrator against a stand-in of the host integrity library,
// found through LD_LIBRARY_PATH. Built twice: with the real query in the
// library (KVT_HOST_QUERY_EXPECTED 1) and with a function of the same name
// but other parameters, which must not be taken for it (0).
#include <kvt-common/module.h>

#include <QtTest>

#include <dlfcn.h>
#include <unistd.h>

namespace {

const char hostLibrary[] = "libtarnhelper.so.1";
constexpr bool hostQueryExpected = KVT_HOST_QUERY_EXPECTED;

// Whether the process has the host library loaded, without loading it.
bool hostLibraryLoaded()
{
    void *handle = dlopen(hostLibrary, RTLD_LAZY | RTLD_NOLOAD);
    if (handle)
        dlclose(handle);
    return handle != nullptr;
}

// How often the stand-in was asked; -1 when it is not loaded.
int hostQueries()
{
    void *handle = dlopen(hostLibrary, RTLD_LAZY | RTLD_NOLOAD);
    if (!handle)
        return -1;
    auto count = reinterpret_cast<int (*)()>(dlsym(handle, "kvtTestIntegrityQueries"));
    const int result = count ? count() : -1;
    dlclose(handle);
    return result;
}

bool asOtherUser(const Module &module)
{
    if (seteuid(65534) != 0)
        qFatal("cannot change the effective user");
    const bool result = Module::isAdministrator(module);
    if (seteuid(0) != 0)
        qFatal("cannot change the effective user back");
    return result;
}

} // namespace

class ModuleHostIntegrityTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void initTestCase();
    void otherUserDoesNotLoadTheHostLibrary();
    void rootAsksTheHost_data();
    void rootAsksTheHost();
    void otherUserAfterLoading();
};

void ModuleHostIntegrityTest::initTestCase()
{
    if (geteuid() != 0)
        QSKIP("the integrity query is only asked for root; run the tests as root");
    // The stand-in must be found where the test says, not elsewhere.
    void *handle = dlopen(hostLibrary, RTLD_LAZY);
    QVERIFY2(handle, dlerror());
    dlclose(handle);
    QVERIFY(!hostLibraryLoaded());
}

void ModuleHostIntegrityTest::otherUserDoesNotLoadTheHostLibrary()
{
    Module module(QStringLiteral("m"));
    QVERIFY(!asOtherUser(module));
    QVERIFY(!hostLibraryLoaded());
}

void ModuleHostIntegrityTest::rootAsksTheHost_data()
{
    QTest::addColumn<QByteArray>("hostAnswer");
    QTest::addColumn<bool>("expected");

    QTest::newRow("highest level") << QByteArray("1") << true;
    // Without the query, the host counts as one without integrity levels.
    QTest::newRow("lower level") << QByteArray("0") << !hostQueryExpected;
    QTest::newRow("highest level again") << QByteArray("1") << true;
}

void ModuleHostIntegrityTest::rootAsksTheHost()
{
    QFETCH(QByteArray, hostAnswer);
    QFETCH(bool, expected);

    Module module(QStringLiteral("m"));
    const int before = hostQueries();
    qputenv("KVT_TEST_MAX_MIC", hostAnswer);
    QCOMPARE(Module::isAdministrator(module), expected);
    if (hostQueryExpected) {
        // Asked every time, not once for the life of the process.
        QCOMPARE(hostQueries(), qMax(before, 0) + 1);
    } else {
        // A library without the query is let go again.
        QVERIFY(!hostLibraryLoaded());
    }
}

void ModuleHostIntegrityTest::otherUserAfterLoading()
{
    Module module(QStringLiteral("m"));
    qputenv("KVT_TEST_MAX_MIC", "1");
    const int before = hostQueries();
    QVERIFY(!asOtherUser(module));
    QCOMPARE(hostQueries(), before);
    QCOMPARE(Module::isAdministrator(module), true);
}

QTEST_GUILESS_MAIN(ModuleHostIntegrityTest)
#include "tst_modulehostintegrity.moc"
