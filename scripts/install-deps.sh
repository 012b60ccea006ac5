#!/bin/sh
# Installs the Debian packages needed to build, test, benchmark and run the
# demo of libkvt-common. Only missing packages are installed, and the package
# lists are refreshed only when something is missing. Works as root or
# through sudo.
#
# Usage: install-deps.sh [docs]
#   docs   also the tools of the API reference (Doxygen, qhelpgenerator)
set -eu

packages="
cmake
make
g++
pkg-config
qtbase5-dev
libqt5xmlpatterns5-dev
qttools5-dev
qttools5-dev-tools
libqt5svg5
xvfb
xauth
libbenchmark-dev
dpkg
coreutils
util-linux
postgresql
postgresql-client
clang
libclang-rt-dev
"

# The API reference is built only on request (make docs, CI).
docs_packages="
doxygen
qhelpgenerator-qt5
"
for arg in "$@"; do
    case "$arg" in
        docs) packages="$packages $docs_packages" ;;
        *) echo "install-deps: unknown argument '$arg' (expected: docs)" >&2; exit 2 ;;
    esac
done

missing=""
for p in $packages; do
    status=$(dpkg-query -W -f='${Status}' "$p" 2>/dev/null || true)
    case "$status" in
        "install ok installed") ;;
        *) missing="$missing $p" ;;
    esac
done

if [ -z "$missing" ]; then
    echo "install-deps: all packages present"
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
