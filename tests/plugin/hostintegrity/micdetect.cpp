// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Stands in for the host integrity library in tests. It answers from the
// environment (KVT_TEST_MAX_MIC=0 means "not at the highest level") and
// counts how often it was asked.
#include <cstdlib>
#include <cstring>

#define KVT_VISIBLE __attribute__((visibility("default")))

namespace {
int queries = 0;
}

class KVT_VISIBLE MICDetect
{
public:
#ifdef KVT_WRONG_SIGNATURE
    // Same name, other parameters: not the function the library looks for.
    static bool isCurrentProcessHasMaxMIC(int pid);
#else
    static bool isCurrentProcessHasMaxMIC();
#endif
};

#ifdef KVT_WRONG_SIGNATURE
bool MICDetect::isCurrentProcessHasMaxMIC(int)
#else
bool MICDetect::isCurrentProcessHasMaxMIC()
#endif
{
    ++queries;
    const char *answer = std::getenv("KVT_TEST_MAX_MIC");
    return !(answer && std::strcmp(answer, "0") == 0);
}

extern "C" KVT_VISIBLE int kvtTestIntegrityQueries()
{
    return queries;
}
