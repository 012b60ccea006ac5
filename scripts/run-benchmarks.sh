#!/bin/sh
# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later
# Runs every benchmark program of a build folder (default: build) on the
# offscreen platform. Extra arguments go to each program, for example
# --benchmark_filter=Walk.
set -eu
build=${1:-build}
[ $# -gt 0 ] && shift
list="$build/bench/benchmarks.txt"
if [ ! -f "$list" ]; then
    echo "run-benchmarks: $list not found; configure with -DKVT_BUILD_BENCH=ON" >&2
    exit 1
fi
export QT_QPA_PLATFORM=offscreen
while read -r name; do
    [ -n "$name" ] || continue
    echo "== $name"
    "$build/bench/$name" --benchmark_counters_tabular=true "$@"
done < "$list"
