# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later

# Configuration-file rewrite beside sed -i doing the same edit.
kvt_add_benchmark(bench_configfile bench_system/configfilebench.cpp)
