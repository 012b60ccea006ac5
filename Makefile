# SPDX-FileCopyrightText: 2026 The libkvt-common developers
# SPDX-License-Identifier: LGPL-2.1-or-later

# Thin wrapper over CMake. The build folder is build/ (build-asan/ for the
# address sanitizer build, build-tsan/ for the thread sanitizer build,
# build-fuzz/ for the fuzz targets). Each command installs only the Debian
# packages it needs.

BUILD      ?= build
ASAN_BUILD ?= build-asan
TSAN_BUILD ?= build-tsan
FUZZ_BUILD ?= build-fuzz
FUZZ_SECONDS ?= 60
# The tests that run work on threads: tasks, observer, service tasks,
# processes, PostgreSQL.
TSAN_TARGETS ?= tst_thread tst_taskobserver tst_elementtasks tst_servicetasks tst_process tst_pgsql
TSAN_TESTS   ?= ^(tst_thread|tst_taskobserver|tst_elementtasks|tst_servicetasks|tst_process|tst_pgsql)
JOBS       ?= $(shell nproc 2>/dev/null || echo 2)
CMAKE_ARGS ?=
PREFIX     ?= /usr/local

.PHONY: all configure build test demo bench install asan-test tsan-test fuzz fuzz-run clean lupdate docs deb

all: build

configure:
	cmake -S . -B $(BUILD) -DCMAKE_INSTALL_PREFIX=$(PREFIX) $(CMAKE_ARGS)

build: configure
	cmake --build $(BUILD) -j $(JOBS)

# The benchmarks are outside the default build: neither `make test` nor
# `make demo` compiles them.
test:
	sh scripts/install-deps.sh test
	$(MAKE) build
	cd $(BUILD) && ctest --output-on-failure -j $(JOBS)

# kvt-admin on a sandbox of copied /etc files (apps/kvt-admin/demo.sh); only
# the tool and its plugins are built.
demo:
	sh scripts/install-deps.sh demo
	$(MAKE) configure
	cmake --build $(BUILD) -j $(JOBS) --target kvt-admin
	sh apps/kvt-admin/demo.sh $(BUILD) $(ARGS)

bench:
	sh scripts/install-deps.sh bench
	cmake -S . -B $(BUILD) -DKVT_BUILD_BENCH=ON -DCMAKE_INSTALL_PREFIX=$(PREFIX) $(CMAKE_ARGS)
	cmake --build $(BUILD) -j $(JOBS) --target kvt_benchmarks
	sh scripts/run-benchmarks.sh $(BUILD)

install: build
	cmake --install $(BUILD)

asan-test:
	sh scripts/install-deps.sh test
	cmake -S . -B $(ASAN_BUILD) -DCMAKE_BUILD_TYPE=Debug -DKVT_SANITIZE=ON $(CMAKE_ARGS)
	cmake --build $(ASAN_BUILD) -j $(JOBS)
	cd $(ASAN_BUILD) && ctest --output-on-failure -j $(JOBS)

tsan-test:
	sh scripts/install-deps.sh test
	cmake -S . -B $(TSAN_BUILD) -DCMAKE_BUILD_TYPE=Debug -DKVT_TSAN=ON -DKVT_BUILD_EXAMPLES=OFF $(CMAKE_ARGS)
	cmake --build $(TSAN_BUILD) -j $(JOBS) --target $(TSAN_TARGETS)
	cd $(TSAN_BUILD) && ctest --output-on-failure -j $(JOBS) -R '$(TSAN_TESTS)'

# libFuzzer targets (clang) for the parsers and the configuration line handling.
fuzz:
	sh scripts/install-deps.sh fuzz
	cmake -S fuzz -B $(FUZZ_BUILD) -DCMAKE_CXX_COMPILER=clang++ $(CMAKE_ARGS)
	cmake --build $(FUZZ_BUILD) -j $(JOBS)

# Each fuzz target for FUZZ_SECONDS, from the seed corpus in fuzz/corpus/.
fuzz-run: fuzz
	sh fuzz/run.sh $(FUZZ_BUILD) $(FUZZ_SECONDS)

# The API reference (HTML and Qt help file) in $(BUILD)/docs/; installed by
# `make install` once built this way.
docs:
	sh scripts/install-deps.sh docs
	cmake -S . -B $(BUILD) -DKVT_BUILD_DOCS=ON -DCMAKE_INSTALL_PREFIX=$(PREFIX) $(CMAKE_ARGS)
	cmake --build $(BUILD) --target docs

# Debian packages of the tree, written to ../ as dpkg-buildpackage does.
deb:
	sh scripts/install-deps.sh package
	dpkg-buildpackage -us -uc -b

lupdate: configure
	cmake --build $(BUILD) --target lupdate

clean:
	rm -rf $(BUILD) $(ASAN_BUILD) $(TSAN_BUILD) $(FUZZ_BUILD)
