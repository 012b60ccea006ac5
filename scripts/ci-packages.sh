#!/usr/bin/env bash
# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later
#
# Builds the Debian packages from a copy of the tree, checks them with
# lintian, installs them on this machine with apt-get, builds the
# installed-consumer project against /usr (CMake package and pkg-config) and
# runs it, then removes the packages again. Needs root or sudo.
#
#   scripts/ci-packages.sh [output folder]     (default: a temporary folder)
#
# DEB_BUILD_OPTIONS is passed on (CI uses "nocheck parallel=2": the tests have
# run already).
set -euo pipefail
cd "$(dirname "$0")/.."
source_dir=$PWD

if [ "$(id -u)" -eq 0 ]; then sudo=""; else sudo="sudo"; fi
apt() { $sudo env DEBIAN_FRONTEND=noninteractive apt-get -y -qq "$@"; }

out=${1:-$(mktemp -d)}
mkdir -p "$out"
out=$(cd "$out" && pwd)
start=$SECONDS

sh scripts/install-deps.sh package
# Exactly the build dependencies the packages declare, the documentation's too;
# the package lists are refreshed only when something is missing.
if ! (cd "$source_dir" && dpkg-checkbuilddeps >/dev/null 2>&1); then
    apt update
    apt build-dep "$source_dir"
fi

# A clean copy: dpkg-buildpackage writes into the tree and beside it.
rm -rf "$out/src"
mkdir -p "$out/src"
tar -C "$source_dir" --exclude='./build*' --exclude='./obj-*' --exclude=./.git -cf - . | tar -C "$out/src" -xf -
(cd "$out/src" && dpkg-buildpackage -us -uc -b)
built=$SECONDS

changes=$(ls "$out"/libkvt-common_*.changes)
lintian --fail-on error --info "$changes"

packages=$(cd "$out" && ls ./*.deb | sed 's|^\./||; s|_.*||' | sort -u)
remove_packages() { apt purge $packages >/dev/null || true; }
trap remove_packages EXIT
(cd "$out" && apt install ./*.deb)

# The consumer sees only what the packages installed under /usr.
consumer="$out/consumer"
rm -rf "$consumer"
cmake -S tests/consumer/project -B "$consumer" -DCMAKE_BUILD_TYPE=Release >/dev/null
cmake --build "$consumer"
export QT_QPA_PLATFORM=offscreen
expect() {
    local what=$1 pattern=$2; shift 2
    local output
    output=$("$@")
    echo "$what: $output"
    if ! grep -q -- "$pattern" <<<"$output"; then
        echo "ci-packages: $what: expected '$pattern'" >&2
        exit 1
    fi
}
version=$(dpkg-parsechangelog -l debian/changelog -S Version)
expect "cmake consumer" "consumer: 2 rows, Name/Value, version ${version%%-*}" "$consumer/kvt-consumer"
expect "translated" "consumer: 2 rows, Имя/Значение" env LC_ALL=ru_RU.UTF-8 LANG=ru_RU.UTF-8 "$consumer/kvt-consumer"
# shellcheck disable=SC2046
c++ -std=c++17 -fPIC tests/consumer/project/main.cpp -o "$consumer/kvt-consumer-pc" $(pkg-config --cflags --libs kvt-common)
expect "pkg-config consumer" "consumer: 2 rows, Name/Value" "$consumer/kvt-consumer-pc"

remove_packages
trap - EXIT
for p in $packages; do
    if dpkg-query -W -f='${Status}' "$p" 2>/dev/null | grep -q "install ok installed"; then
        echo "ci-packages: $p still installed" >&2
        exit 1
    fi
done
echo "ci-packages: built in $((built - start)) s, checked in $((SECONDS - built)) s; packages in $out"
