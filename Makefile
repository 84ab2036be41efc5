# Everything starts here:
#   make demo   build, then run the launcher under Wine on the sample disc
#               (SKU=1..6 picks the disc's edition, ARGS=-l0411 a language)
#   make test   build everything and run every test: host, Win32 (Wine) and end to end
#   make bench  the compositing benchmark, and the time to the first painted frame under Wine
SHELL := /bin/bash
BUILD ?= build
SKU ?= 1
JOBS ?= $(shell nproc)
WINE_ARCH := $(shell scripts/wine-arch.sh)

.PHONY: all deps host win32 win64 build test test-host test-windows demo bench clean

all: build

deps:
	@scripts/install-deps.sh

host: deps
	cmake -S . -B $(BUILD)/host -DCMAKE_BUILD_TYPE=RelWithDebInfo >/dev/null
	cmake --build $(BUILD)/host -j$(JOBS)

define cross_build
	cmake -S . -B $(BUILD)/$(1) -DCMAKE_BUILD_TYPE=Release \
	    -DCMAKE_TOOLCHAIN_FILE=cmake/toolchain-$(1)-mingw.cmake \
	    -DDISCART=$(abspath $(BUILD)/host/tools/discart/discart) -DDISC_SKU=$(SKU) \
	    -DHOST_BUILD=$(abspath $(BUILD)/host) \
	    -DRUNFROMSWAP=$(abspath $(BUILD)/host/tools/runfromswap/runfromswap) >/dev/null
	cmake --build $(BUILD)/$(1) -j$(JOBS) $(2)
endef

win32: host
	$(call cross_build,i686,)

win64: host
	$(call cross_build,x86_64,)

build: win32 win64

test-host: host
	cd $(BUILD)/host && ctest --output-on-failure

test-windows: build
	cd $(BUILD)/$(WINE_ARCH) && ctest --output-on-failure

test: test-host test-windows

demo: host
	$(call cross_build,$(WINE_ARCH),)
	AUTOPLAY_ARGS="$(ARGS)" scripts/demo.sh $(BUILD)/$(WINE_ARCH)

bench: host
	$(call cross_build,$(WINE_ARCH),)
	$(BUILD)/host/bench/masked_blend_bench
	scripts/first-paint.sh $(BUILD)/$(WINE_ARCH)

clean:
	rm -rf $(BUILD)
