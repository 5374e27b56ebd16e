# The two commands of the README:
#   make demo   set up, build, and open the bundled demo comp
#   make test   set up, build with address/undefined sanitizers, run every test
JOBS ?= $(shell nproc)

.PHONY: setup demo test release asan bench clean

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

bench: release
	./build/release/bin/orbane_bench

clean:
	rm -rf build
