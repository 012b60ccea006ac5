// SPDX-FileCopyrightText: 2026 The libkvt-common developers
// SPDX-License-Identifier: LGPL-2.1-or-later

// Rewriting a 200 000-line configuration file, changing 1 000 keys, with
// RegExpHandler::rewriteSystemConfigureFile beside `sed -i` making the same
// edit with one script. Both start from a fresh copy of the same file on
// every iteration (outside the timed part) and must produce the same bytes.
#include <kvt-common/regexphandler.h>

#include <benchmark/benchmark.h>

#include <QCoreApplication>
#include <QFile>
#include <QProcess>
#include <QTemporaryDir>

#include <cstdio>
#include <memory>

namespace {

const int lineCount = 200000;

// Keys whose number ends in 000, 200, 400, 600 or 800: every 200th line, so
// 1 000 keys, none of them on a comment or blank line.
const char keyPattern[] = "^(key\\d*[02468]00)\\s*=";
const char sedScript[] = "s/^\\(key[0-9]*[02468]00\\) *=.*$/\\1 = changed/";

QByteArray makeContent()
{
    QByteArray content;
    content.reserve(lineCount * 24);
    for (int i = 0; i < lineCount; ++i) {
        if (i % 10 == 9)
            content += "# comment for line " + QByteArray::number(i) + '\n';
        else if (i % 50 == 25)
            content += '\n';
        else
            content += "key" + QByteArray::number(i).rightJustified(6, '0') + " = value" + QByteArray::number(i)
                       + '\n';
    }
    return content;
}

class ChangeKeys : public RegExpHandler
{
public:
    ChangeKeys()
        : RegExpHandler(QString::fromLatin1(keyPattern))
    {
    }
    bool handleRegExp(QByteArray *line) override
    {
        if (!line)
            return false;
        *line = regExp().cap(1).toLatin1() + " = changed";
        ++changed;
        return true;
    }
    int changed = 0;
};

struct Fixture
{
    QTemporaryDir dir;
    QByteArray original = makeContent();
    QString file = dir.filePath(QStringLiteral("big.conf"));

    void reset()
    {
        QFile f(file);
        f.open(QIODevice::WriteOnly | QIODevice::Truncate);
        f.write(original);
    }
    QByteArray content() const
    {
        QFile f(file);
        f.open(QIODevice::ReadOnly);
        return f.readAll();
    }
};

Fixture &fixture()
{
    static Fixture f;
    return f;
}

bool runRewrite(Fixture &f, int *changed)
{
    ChangeKeys handler;
    QString error;
    const bool ok = RegExpHandler::rewriteSystemConfigureFile(f.file, handler, error, false);
    if (!ok)
        std::fprintf(stderr, "rewrite failed: %s\n", qPrintable(error));
    if (changed)
        *changed = handler.changed;
    return ok;
}

bool runSed(Fixture &f)
{
    QProcess sed;
    sed.start(QStringLiteral("sed"), {QStringLiteral("-i"), QStringLiteral("-e"), QString::fromLatin1(sedScript), f.file});
    return sed.waitForFinished(60000) && sed.exitStatus() == QProcess::NormalExit && sed.exitCode() == 0;
}

void BM_RewriteSystemConfigureFile(benchmark::State &state)
{
    Fixture &f = fixture();
    for (auto _ : state) {
        state.PauseTiming();
        f.reset();
        state.ResumeTiming();
        if (!runRewrite(f, nullptr)) {
            state.SkipWithError("rewrite failed");
            break;
        }
    }
    state.counters["lines"] = lineCount;
}

void BM_SedInPlace(benchmark::State &state)
{
    Fixture &f = fixture();
    for (auto _ : state) {
        state.PauseTiming();
        f.reset();
        state.ResumeTiming();
        if (!runSed(f)) {
            state.SkipWithError("sed failed");
            break;
        }
    }
    state.counters["lines"] = lineCount;
}

BENCHMARK(BM_RewriteSystemConfigureFile)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_SedInPlace)->Unit(benchmark::kMillisecond);

// Both tools must make the same edit, or the comparison means nothing.
bool sameResult()
{
    Fixture &f = fixture();
    f.reset();
    int changed = 0;
    if (!runRewrite(f, &changed))
        return false;
    const QByteArray ours = f.content();
    f.reset();
    if (!runSed(f))
        return false;
    const QByteArray theirs = f.content();
    if (changed != 1000 || ours != theirs) {
        std::fprintf(stderr, "results differ: %d keys changed, %lld vs %lld bytes\n", changed,
                     static_cast<long long>(ours.size()), static_cast<long long>(theirs.size()));
        return false;
    }
    return true;
}

} // namespace

int main(int argc, char **argv)
{
    QCoreApplication app(argc, argv);
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    if (!fixture().dir.isValid() || !sameResult())
        return 1;
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
