# Brakmorph: `make demo` sets up, builds and renders the demo; `make test` sets up,
# builds all three plug-in binaries and runs every test.
JOBS ?= 2
BUILD_TYPE ?= Release
LINUX := build/linux
WIN32_DIR := build/win32
WIN64_DIR := build/win64
ASAN := build/asan
FUZZ := build/fuzz
TSAN := build/tsan
GEN := $(CURDIR)/$(LINUX)/gen

.PHONY: all setup linux win32 win64 windows asan tsan fuzz demo test test-unit test-asan test-tsan test-fuzz install clean

all: linux windows

setup:
	@if [ "$$(id -u)" -eq 0 ]; then bash scripts/setup-deps.sh; else sudo bash scripts/setup-deps.sh; fi

linux:
	cmake -S . -B $(LINUX) -DCMAKE_BUILD_TYPE=$(BUILD_TYPE) -DBRAKMORPH_WINDOWS_BUILDS="$(CURDIR)/$(WIN32_DIR);$(CURDIR)/$(WIN64_DIR)"
	cmake --build $(LINUX) -j$(JOBS)

win32: linux
	cmake -S . -B $(WIN32_DIR) -DCMAKE_BUILD_TYPE=$(BUILD_TYPE) -DCMAKE_TOOLCHAIN_FILE=cmake/toolchain-mingw32.cmake -DBRAKMORPH_GEN_DIR=$(GEN)
	cmake --build $(WIN32_DIR) -j$(JOBS)

win64: linux
	cmake -S . -B $(WIN64_DIR) -DCMAKE_BUILD_TYPE=$(BUILD_TYPE) -DCMAKE_TOOLCHAIN_FILE=cmake/toolchain-mingw64.cmake -DBRAKMORPH_GEN_DIR=$(GEN)
	cmake --build $(WIN64_DIR) -j$(JOBS)

windows: win32 win64

asan:
	cmake -S . -B $(ASAN) -DCMAKE_BUILD_TYPE=Debug -DBRAKMORPH_SANITIZE=address,undefined -DCMAKE_CXX_FLAGS=-O1
	cmake --build $(ASAN) -j$(JOBS)

# ThreadSanitizer: the host and the plug-ins, for the threaded checks of
# validate, and the MIDI thread tests.
tsan:
	cmake -S . -B $(TSAN) -DCMAKE_BUILD_TYPE=Debug -DBRAKMORPH_SANITIZE=thread -DCMAKE_CXX_FLAGS=-O1 -DBUILD_TESTING=OFF
	cmake --build $(TSAN) -j$(JOBS) --target brakmorph Brakmorph ValidateFaulty midi_thread_tests

fuzz:
	cmake -S fuzz -B $(FUZZ) -DCMAKE_CXX_COMPILER=clang++ -DCMAKE_C_COMPILER=clang
	cmake --build $(FUZZ) -j$(JOBS)

demo: setup linux
	$(LINUX)/bin/brakmorph demo --out-dir out/demo

test-unit: linux windows
	cd $(LINUX) && BRAKMORPH_REQUIRE_WINDOWS=1 ctest --output-on-failure -j$(JOBS)

test-asan: asan
	cd $(ASAN) && ASAN_OPTIONS=detect_leaks=1 UBSAN_OPTIONS=halt_on_error=1:print_stacktrace=1 \
	  ctest --output-on-failure -j$(JOBS) -LE integration

test-tsan: tsan
	bash tests/validate/tsan_validate.sh $(TSAN)
	TSAN_OPTIONS=halt_on_error=1 $(TSAN)/midi_thread_tests --gtest_brief=1

test-fuzz: fuzz
	bash fuzz/run_fuzzers.sh $(FUZZ) 30

test: setup
	$(MAKE) test-unit
	$(MAKE) test-asan
	$(MAKE) test-tsan
	$(MAKE) test-fuzz

install: linux
	mkdir -p $(HOME)/.vst
	cp $(LINUX)/vst/Brakmorph.so $(HOME)/.vst/

clean:
	rm -rf build out
