#!/bin/sh
# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later
#
# demo.sh <build folder> [kvt-admin argument...]
#
# Runs kvt-admin on a sandbox, so the demo never changes this machine: copies
# of a few configuration files of /etc in <build>/demo/sandbox, managed by the
# conffiles plugin through settings kept in <build>/demo/home. With a display
# the window opens; without one the tool prints its --list output and renders
# the window to <build>/demo.png.
set -eu

build=$(cd "${1:?usage: demo.sh <build folder>}" && pwd)
shift
tool="$build/apps/kvt-admin/kvt-admin"
[ -x "$tool" ] || { echo "demo: $tool is not built" >&2; exit 1; }

sandbox="$build/demo/sandbox"
home="$build/demo/home"
mkdir -p "$sandbox" "$home/config/kvt-admin"

files=""
for name in login.defs adduser.conf deluser.conf host.conf; do
    [ -r "/etc/$name" ] || continue
    # A fresh copy each time: what the last demo changed is not kept.
    cp "/etc/$name" "$sandbox/$name"
    files="${files:+$files, }$sandbox/$name"
done
if [ -z "$files" ]; then
    printf '# A sample file: none of the usual files was found in /etc.\nNAME = value  # a comment\nOTHER yes\n' \
        >"$sandbox/sample.conf"
    files="$sandbox/sample.conf"
fi
printf '[conffiles]\nfiles=%s\n' "$files" >"$home/config/kvt-admin/kvt-admin.conf"

export HOME="$home" XDG_CONFIG_HOME="$home/config"
if [ -n "${DISPLAY:-}${WAYLAND_DISPLAY:-}" ]; then
    exec "$tool" "$@"
fi
"$tool" --list "$@"
"$tool" --screenshot "$build/demo.png" "$@"
