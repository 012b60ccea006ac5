// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

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

// How often the stand-in was asked; -1 when the process has not loaded it.
int hostQueries()
{
    void *handle = dlopen(hostLibrary, RTLD_LAZY | RTLD_NOLOAD);
    if (!handle)
        return -1;
    auto count = reinterpret_cast<int (*)()>(dlsym(handle, "kvtTestIntegrityQueries"));
    const int result = count();
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
    void initTestCase()
    {
        if (geteuid() != 0)
            QSKIP("the integrity query is only asked for root; run the tests as root");
        // The stand-in must be found where the test says, not elsewhere.
        void *handle = dlopen(hostLibrary, RTLD_LAZY);
        QVERIFY2(handle, dlerror());
        dlclose(handle);
        QCOMPARE(hostQueries(), -1);
    }

    void isAdministratorAsksTheHost()
    {
        Module module(QStringLiteral("m"));
        // Another user is never at the highest level, and the host is not
        // even loaded to ask.
        QVERIFY(!asOtherUser(module));
        QCOMPARE(hostQueries(), -1);

        // Root is asked every time, not once for the life of the process.
        // Without the query the host counts as one without integrity levels,
        // and the library is let go again.
        int asked = 0;
        for (const QByteArray answer : {"1", "0", "1"}) {
            qputenv("KVT_TEST_MAX_MIC", answer);
            QCOMPARE(Module::isAdministrator(module), answer == "1" || !hostQueryExpected);
            QCOMPARE(hostQueries(), hostQueryExpected ? ++asked : -1);
        }
        QVERIFY(!asOtherUser(module));
        QCOMPARE(hostQueries(), hostQueryExpected ? asked : -1);
    }
};

QTEST_GUILESS_MAIN(ModuleHostIntegrityTest)
#include "tst_modulehostintegrity.moc"
