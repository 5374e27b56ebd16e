# The two commands of the README:
#   make demo   set up, build, and open the bundled demo comp
#   make test   set up, build with address/undefined sanitizers, run every test,
#               then run each fuzz target briefly (clang, libFuzzer)
JOBS ?= $(shell nproc)

.PHONY: setup demo test release asan bench fuzz clean

setup:
	@./scripts/setup.sh

release: setup
	cmake --preset release >/dev/null
	cmake --build --preset release -j $(JOBS)

asan: setup
	cmake --preset asan >/dev/null
	cmake --build --preset asan -j $(JOBS)

demo: release
	./scripts/demo.sh build/release

test: asan
	ctest --preset asan -j $(JOBS)
	JOBS=$(JOBS) ./scripts/fuzz.sh --ci

# A long fuzzing campaign: FUZZ_SECONDS per target (one hour by default).
FUZZ_SECONDS ?= 3600
fuzz: setup
	JOBS=$(JOBS) ./scripts/fuzz.sh $(FUZZ_SECONDS)

# The benchmarks alone, built in release; each goal's figure is the best of the
# repetitions, as the shared machine only ever adds time.
BENCH_ARGS ?= --benchmark_repetitions=3
bench: setup
	cmake --preset release >/dev/null
	cmake --build --preset release -j $(JOBS) --target orbane_bench
	./build/release/bin/orbane_bench $(BENCH_ARGS)

clean:
	rm -rf build
