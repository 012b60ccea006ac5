#!/bin/sh
# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later
#
# Runs every fuzz target of a fuzz build for a while, starting from the seed
# corpus of the repository; new inputs go to the build folder, never into the
# repository. A crash, a sanitizer report or a hang stops the run with the
# reproducing input saved in the build folder.
#   fuzz/run.sh [build folder (build-fuzz)] [seconds per target (60)]
set -eu

build=${1:-build-fuzz}
seconds=${2:-60}
here=$(cd "$(dirname "$0")" && pwd)

for target in clusterline psql rewrite; do
    mkdir -p "$build/corpus-$target" "$build/artifacts-$target"
    echo "fuzz: $target for ${seconds}s"
    log="$build/fuzz-$target.log"
    if ! LC_ALL=C.UTF-8 "$build/fuzz_$target" -max_total_time="$seconds" -max_len=2048 -timeout=10 \
        -rss_limit_mb=2048 -print_final_stats=1 -artifact_prefix="$build/artifacts-$target/" \
        "$build/corpus-$target" "$here/corpus/$target" >"$log" 2>&1; then
        tail -n 60 "$log"
        echo "fuzz: $target failed; the input is in $build/artifacts-$target/" >&2
        exit 1
    fi
    grep -E '^(stat::number_of_executed_units|stat::average_exec_per_sec)' "$log" || true
done
