#!/bin/sh
# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later
#
# run-in-xvfb.sh <program> [argument...]
#
# Runs a program inside a private X server: starts Xvfb on a free display
# (Xvfb picks it and reports it through -displayfd), runs the program there
# on Qt's xcb platform, stops the server and exits with the program's code.
# When no X server can be started, says why and exits 77, which CTest
# reports as a skipped test.
set -u

skip() {
    echo "SKIP: $*" >&2
    exit 77
}

command -v Xvfb >/dev/null 2>&1 || skip "Xvfb is not installed (scripts/install-deps.sh installs it)"
[ "$#" -ge 1 ] || { echo "usage: $0 program [argument...]" >&2; exit 2; }

work=$(mktemp -d "${TMPDIR:-/tmp}/kvt-xvfb.XXXXXX") || skip "cannot create a temporary folder"
xvfb_pid=""
cleanup() {
    if [ -n "$xvfb_pid" ]; then
        kill "$xvfb_pid" 2>/dev/null
        wait "$xvfb_pid" 2>/dev/null
    fi
    rm -rf "$work"
}
trap cleanup EXIT
trap 'exit 130' INT TERM

Xvfb -displayfd 3 -screen 0 1280x1024x24 -nolisten tcp -noreset \
    3>"$work/display" >"$work/xvfb.log" 2>&1 &
xvfb_pid=$!

# Xvfb writes the display number once it accepts connections.
tries=0
while [ ! -s "$work/display" ]; do
    if ! kill -0 "$xvfb_pid" 2>/dev/null; then
        xvfb_pid=""
        skip "Xvfb did not start: $(tail -n 3 "$work/xvfb.log" | tr '\n' ' ')"
    fi
    tries=$((tries + 1))
    [ "$tries" -le 200 ] || skip "Xvfb did not report a display within 20 seconds"
    sleep 0.1
done
display=$(head -n 1 "$work/display")

DISPLAY=":$display" QT_QPA_PLATFORM=xcb "$@"
status=$?
exit "$status"
