# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later

kvt_add_benchmark(bench_element "${CMAKE_CURRENT_LIST_DIR}/bench_element.cpp" LIBS Qt5::Gui)
