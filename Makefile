# Thin wrapper over CMake. The build folder is build/ (build-asan/ for the
# sanitizer build). Each command installs only the Debian packages it needs.

BUILD      ?= build
ASAN_BUILD ?= build-asan
JOBS       ?= $(shell nproc 2>/dev/null || echo 2)
CMAKE_ARGS ?=
PREFIX     ?= /usr/local

.PHONY: all configure build test demo bench install asan-test clean lupdate deb

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

# Debian packages of the tree, written to ../ as dpkg-buildpackage does.
deb:
	sh scripts/install-deps.sh package
	dpkg-buildpackage -us -uc -b

lupdate: configure
	cmake --build $(BUILD) --target lupdate

clean:
	rm -rf $(BUILD) $(ASAN_BUILD)
