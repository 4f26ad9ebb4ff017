# The commands of daily life. Each first installs what the machine lacks (Debian packages, see tools/setup), so on a
# fresh machine one command is enough. Builds go to build/; PRESET=debug, asan or tsan takes another build than release.

PRESET ?= release
PREFIX ?= /usr/local
FUZZ_SECONDS ?= 600
JOBS ?= $(shell nproc)
BUILD = build/$(PRESET)

.PHONY: help build test demo docs bench format lint fuzz coverage install package clean

help:
	@echo "make test     build and run the whole suite    make demo    report on recorded signals"
	@echo "make docs     reference as HTML                make bench   measure beside the peers"
	@echo "make format   clang-format everything          make lint    clang-format and clang-tidy checks"
	@echo "make coverage what the suite reaches           make fuzz    look for inputs that break calls"
	@echo "make install  into PREFIX=$(PREFIX)            make package Debian packages"

build:
	tools/setup build
	cmake --preset $(PRESET) $(CMAKE_ARGS)
	cmake --build $(BUILD) --parallel $(JOBS)

test:
	tools/setup build test
	cmake --preset $(PRESET) -DKRNUMER_TESTS=ON $(CMAKE_ARGS)
	cmake --build $(BUILD) --parallel $(JOBS)
	ctest --preset $(PRESET) --parallel $(JOBS)

demo:
	tools/setup build demo
	tools/demo $(PRESET) $(JOBS)

docs:
	tools/setup docs
	tools/docs

bench:
	tools/setup build bench
	tools/bench $(JOBS)

format:
	tools/setup lint
	tools/lint --fix

lint:
	tools/setup build test lint
	tools/lint $(LINT_ARGS)

coverage:
	tools/setup build test coverage
	tools/coverage $(JOBS)

fuzz:
	tools/setup build fuzz
	tools/fuzz $(FUZZ_SECONDS) $(JOBS)

install: build
	cmake --install $(BUILD) --prefix $(PREFIX)

package:
	tools/setup build package
	cmake --preset package
	cmake --build --preset package --parallel $(JOBS)
	cd build/package && cpack -G DEB

clean:
	rm -rf build
