# Thin wrapper over CMake. The build folder is build/ (build-asan/ for the
# sanitizer build).

BUILD      ?= build
ASAN_BUILD ?= build-asan
JOBS       ?= $(shell nproc 2>/dev/null || echo 2)
CMAKE_ARGS ?=
PREFIX     ?= /usr/local

.PHONY: all deps configure build test demo bench install asan-test clean lupdate

all: build

deps:
	sh scripts/install-deps.sh

configure:
	cmake -S . -B $(BUILD) -DKVT_BUILD_BENCH=ON -DCMAKE_INSTALL_PREFIX=$(PREFIX) $(CMAKE_ARGS)

build: configure
	cmake --build $(BUILD) -j $(JOBS)

test: deps build
	cd $(BUILD) && ctest --output-on-failure -j $(JOBS)

# kvt-admin on a sandbox of copied /etc files (apps/kvt-admin/demo.sh); only
# the tool and its plugins are built.
demo: deps configure
	cmake --build $(BUILD) -j $(JOBS) --target kvt-admin
	sh apps/kvt-admin/demo.sh $(BUILD) $(ARGS)

bench: deps build
	sh scripts/run-benchmarks.sh $(BUILD)

install: build
	cmake --install $(BUILD)

asan-test: deps
	cmake -S . -B $(ASAN_BUILD) -DCMAKE_BUILD_TYPE=Debug -DKVT_SANITIZE=ON $(CMAKE_ARGS)
	cmake --build $(ASAN_BUILD) -j $(JOBS)
	cd $(ASAN_BUILD) && ctest --output-on-failure -j $(JOBS)

lupdate: configure
	cmake --build $(BUILD) --target lupdate

clean:
	rm -rf $(BUILD) $(ASAN_BUILD)
