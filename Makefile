# make run       build, then run the main job on the bundled example
# make test      build and run every test
# make build     release programs in build/release/bin/
# make sanitize  every test under the address and undefined-behaviour sanitizers
# make lint      formatting, clang-tidy, the order of the folders
# make bench     the speed table, beside R and SciPy (installed where they are missing)
# make coverage  how often the reported deviation holds the true 100-year event (two minutes)
# make validation  every fit against the same fit in R; rewrites its tables in docs/methods.md.
#                  PUBLISHED=DIR adds reference_fits.csv of that directory, with its series
# make test-cluster  the grid batch under a Slurm of its own, mpirun and GNU parallel (as root)
# make fuzz      each fuzz target for FUZZ_SECONDS seconds (default 600)

JOBS ?= $(shell nproc)
FUZZ_SECONDS ?= 600

# Objects of one clone serve the next, wherever it lies.
export CCACHE_BASEDIR := $(CURDIR)
export CCACHE_NOHASHDIR := 1

.PHONY: run test test-cluster build sanitize lint bench coverage validation fuzz format packages clean
.DEFAULT_GOAL := build

packages:
	@tools/install-packages

# A build is configured anew only when its preset has no cache yet; CMake follows changes itself.
build/%/build.ninja: CMakePresets.json | packages
	cmake --preset $*

build: build/release/build.ninja
	cmake --build build/release -j $(JOBS)

run: build
	examples/run build/release/bin

test: build/dev/build.ninja
	cmake --build build/dev -j $(JOBS)
	ctest --test-dir build/dev -j $(JOBS) --output-on-failure

test-cluster: build
	@tools/install-packages tests/cluster/packages.txt
	PYTHONDONTWRITEBYTECODE=1 python3 tests/cluster/run.py build/release/bin

sanitize: build/sanitize/build.ninja
	cmake --build build/sanitize -j $(JOBS)
	ctest --test-dir build/sanitize -j $(JOBS) --output-on-failure

lint: build/dev/build.ninja
	cmake --build build/dev -j $(JOBS) --target lint

format: packages
	git ls-files '*.cpp' '*.h' | xargs clang-format-14 -i

bench: build
	bench/run build/release/bin

coverage: build
	build/release/bin/ryn_coverage

validation: build
	@tools/install-packages tools/validation/packages.txt
	PYTHONDONTWRITEBYTECODE=1 tools/validation/validate.py build/release/bin/ryn --docs docs/methods.md \
		--out build/validation/fits.csv $(if $(PUBLISHED),--published $(PUBLISHED))

fuzz: build/fuzz/build.ninja
	cmake --build build/fuzz -j $(JOBS)
	fuzz/run build/fuzz $(FUZZ_SECONDS)

clean:
	rm -rf build
