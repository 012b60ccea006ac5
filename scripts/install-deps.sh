#!/bin/sh
# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later
# Installs the Debian packages that one command of the project needs, and
# nothing more:
#
#   install-deps.sh [build|test|demo|bench|fuzz|package|docs|lint]...
#
#   build    compile the library, its examples and translations (the default)
#   test     build + run the tests (X server for the GUI tests, the tools the
#            tests drive, a PostgreSQL server for the cluster tests)
#   demo     build + run kvt-admin on its sandbox
#   bench    build + run the benchmarks (Google Benchmark)
#   fuzz     build + run the fuzz targets (clang with libFuzzer)
#   package  build the Debian packages (debhelper, lintian, test tools)
#   docs     build the API reference (Doxygen, qhelpgenerator)
#   lint     check licence information (reuse)
#
# Only missing packages are installed, and the package lists are refreshed only
# when something is missing. Works as root or through sudo.
set -eu

build="
cmake
make
g++
pkg-config
qtbase5-dev
libqt5xmlpatterns5-dev
qttools5-dev
qttools5-dev-tools
"
test="
xvfb
xauth
libqt5svg5
dpkg
coreutils
util-linux
postgresql
postgresql-client
"
fuzz="
clang
libclang-rt-dev
"
demo="
libqt5svg5
"
bench="
libbenchmark-dev
"
package="
debhelper
dpkg-dev
fakeroot
lintian
xvfb
xauth
"
docs="
doxygen
qhelpgenerator-qt5
"
lint="
reuse
"

[ $# -gt 0 ] || set -- build
packages="$build"
for command in "$@"; do
    case "$command" in
        build) ;;
        test) packages="$packages $test" ;;
        demo) packages="$packages $demo" ;;
        bench) packages="$packages $bench" ;;
        fuzz) packages="$packages $fuzz" ;;
        package) packages="$packages $package" ;;
        docs) packages="$packages $docs" ;;
        lint) packages="$packages $lint" ;;
        *)
            echo "install-deps: unknown command '$command'" >&2
            echo "install-deps: use build, test, demo, bench, fuzz, package, docs or lint" >&2
            exit 2
            ;;
    esac
done

missing=""
for p in $packages; do
    case " $missing " in *" $p "*) continue ;; esac
    status=$(dpkg-query -W -f='${Status}' "$p" 2>/dev/null || true)
    case "$status" in
        "install ok installed") ;;
        *) missing="$missing $p" ;;
    esac
done

if [ -z "$missing" ]; then
    echo "install-deps: all packages present for: $*"
    exit 0
fi

if [ "$(id -u)" -eq 0 ]; then
    run=""
elif command -v sudo >/dev/null 2>&1; then
    run="sudo"
else
    echo "install-deps: missing packages:$missing" >&2
    echo "install-deps: run this script as root or install sudo" >&2
    exit 1
fi

echo "install-deps: installing$missing"
$run env DEBIAN_FRONTEND=noninteractive apt-get update -qq
# shellcheck disable=SC2086
$run env DEBIAN_FRONTEND=noninteractive apt-get install -y -qq --no-install-recommends $missing
