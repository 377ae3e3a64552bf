# Every target does its own set-up: missing packages are installed, the build is configured.
.PHONY: all deps build test test-asan install package run bench fuzz fuzz-ci format clean

JOBS ?= $(shell nproc)
EXAMPLE ?= examples/estuary.setup
PREFIX ?= /usr/local

all: build

deps:
	@./scripts/install-deps

build/default/build.ninja: | deps
	cmake --preset default

build: build/default/build.ninja
	cmake --build --preset default -j $(JOBS)

# One process per test, as many at once as there are cores.
test: build
	ctest --preset default -j $(JOBS)

build/asan/build.ninja: | deps
	cmake --preset asan

test-asan: build/asan/build.ninja
	cmake --build --preset asan -j $(JOBS)
	ctest --preset asan -j $(JOBS)

install: build
	cmake --install build/default --prefix $(PREFIX)

# A .deb of the default build (stripped), in build/default.
package: build
	cd build/default && cpack -G DEB

run: build
	@if [ -x build/default/mudsetup-editor ] && [ -z "$$DISPLAY$$WAYLAND_DISPLAY$$QT_QPA_PLATFORM" ]; then \
	  echo "make run: the editor needs a display (neither DISPLAY nor WAYLAND_DISPLAY is set)." >&2; \
	  echo "Without one, draw it into a PNG:" >&2; \
	  echo "  build/default/mudsetup-editor --screenshot OUT.png [--select PATH] $(EXAMPLE)" >&2; \
	  exit 2; \
	elif [ -x build/default/mudsetup-editor ]; then \
	  build/default/mudsetup-editor $(EXAMPLE); \
	else \
	  build/default/mudsetup show $(EXAMPLE); \
	fi

build/release/build.ninja: | deps
	cmake --preset release

bench: build/release/build.ninja
	cmake --build --preset release -j $(JOBS)
	build/release/bench/paramfile_bench
	build/release/bench/setup_bench
	build/release/bench/datafile_bench
	build/release/bench/mesh_bench
	build/release/bench/output_bench
	QT_QPA_PLATFORM=offscreen build/release/bench/map_bench
	QT_QPA_PLATFORM=offscreen build/release/bench/editor_bench

build/fuzz/build.ninja: | deps
	cmake --preset fuzz

fuzz: build/fuzz/build.ninja
	cmake --build --preset fuzz -j $(JOBS)
	mkdir -p build/fuzz/corpus
	build/fuzz/fuzz/paramfile_fuzz build/fuzz/corpus fuzz/corpus

# A short, bounded run for CI.
fuzz-ci: build/fuzz/build.ninja
	cmake --build --preset fuzz -j $(JOBS)
	mkdir -p build/fuzz/corpus
	mkdir -p build/fuzz/corpus-setup
	mkdir -p build/fuzz/corpus-mesh
	build/fuzz/fuzz/paramfile_fuzz -max_total_time=60 -rss_limit_mb=2048 -max_len=16384 build/fuzz/corpus fuzz/corpus
	build/fuzz/fuzz/setup_fuzz -max_total_time=60 -rss_limit_mb=2048 -max_len=65536 build/fuzz/corpus-setup fuzz/corpus-setup
	build/fuzz/fuzz/mesh_fuzz -max_total_time=60 -rss_limit_mb=2048 build/fuzz/corpus-mesh fuzz/corpus-mesh
	mkdir -p build/fuzz/corpus-datafile
	build/fuzz/fuzz/datafile_fuzz -max_total_time=60 -rss_limit_mb=2048 build/fuzz/corpus-datafile fuzz/corpus-datafile
	mkdir -p build/fuzz/corpus-netcdf
	build/fuzz/fuzz/netcdf_header_fuzz -max_total_time=60 -rss_limit_mb=2048 -malloc_limit_mb=512 -max_len=65536 build/fuzz/corpus-netcdf fuzz/corpus-netcdf

format:
	git ls-files '*.cpp' '*.h' | xargs clang-format -i

clean:
	rm -rf build
