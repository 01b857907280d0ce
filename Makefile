# Thin front door over CMake. Every target installs missing Debian packages first.
JOBS ?= $(shell nproc)
BENCH_FILTER ?= .
FUZZ_SECONDS ?= 600
CMAKE_FLAGS ?=
ifneq ($(CI),)
CMAKE_FLAGS += -DVELA_WERROR=ON
endif
CONFIGURE = cmake -G Ninja -S . -DCMAKE_BUILD_TYPE
SOURCES = $(shell git ls-files --cached --others --exclude-standard '*.h' '*.cpp' 2>/dev/null)

.PHONY: deps demo fuzz soak test bench sanitize tsan clang header-check layer-check format format-check install-check

deps:
	@scripts/install-deps

# Configured once; after that Ninja re-runs CMake itself when a CMakeLists changes.
build/build.ninja: | deps
	$(CONFIGURE)=Debug -B build $(CMAKE_FLAGS)

demo: build/build.ninja
	cmake --build build --target vela-demo vela -j $(JOBS)
	./build/examples/vela-demo build/demo-project.json
	./build/tools/vela/vela info build/demo-project.json

test: build/build.ninja
	cmake --build build -j $(JOBS)
	ctest --test-dir build --output-on-failure -j $(JOBS)

bench: deps
	$(CONFIGURE)=Release -B build-release -DVELA_BUILD_TESTS=OFF -DVELA_BUILD_EXAMPLES=OFF
	cmake --build build-release -j $(JOBS)
	@for b in build-release/bench/bench_*; do echo "== $$b"; $$b --benchmark_filter='$(BENCH_FILTER)'; done

sanitize: deps
	$(CONFIGURE)=Debug -B build-asan -DVELA_SANITIZE=address,undefined -DVELA_BUILD_BENCH=OFF $(CMAKE_FLAGS)
	cmake --build build-asan -j $(JOBS)
	ctest --test-dir build-asan --output-on-failure -j $(JOBS)

# The concurrency suites under ThreadSanitizer.
tsan: deps
	$(CONFIGURE)=RelWithDebInfo -B build-tsan -DVELA_SANITIZE=thread -DVELA_BUILD_BENCH=OFF -DVELA_BUILD_EXAMPLES=OFF $(CMAKE_FLAGS)
	cmake --build build-tsan -j $(JOBS)
	TSAN_OPTIONS=halt_on_error=1 ctest --test-dir build-tsan -R Concurrency --output-on-failure -j $(JOBS)

# The whole suite built with Clang as well, in a tree of its own, with the
# portable 128-bit arithmetic that compilers without __int128 get.
clang: deps
	CXX=clang++ $(CONFIGURE)=Debug -B build-clang -DVELA_BUILD_BENCH=OFF -DVELA_BUILD_EXAMPLES=OFF \
	  -DCMAKE_CXX_FLAGS=-DVELA_PORTABLE_INT128 $(CMAKE_FLAGS)
	cmake --build build-clang -j $(JOBS)
	ctest --test-dir build-clang --output-on-failure -j $(JOBS)

# The project parser under libFuzzer (Clang, AddressSanitizer, UBSan) for
# FUZZ_SECONDS, seeded with the sample documents; new inputs gather in
# build-fuzz/corpus, findings in build-fuzz/findings (the run fails on one).
fuzz: deps
	CXX=clang++ $(CONFIGURE)=RelWithDebInfo -B build-fuzz -DVELA_BUILD_FUZZ=ON -DVELA_SANITIZE=address,undefined \
	  -DVELA_BUILD_TESTS=OFF -DVELA_BUILD_BENCH=OFF -DVELA_BUILD_EXAMPLES=OFF -DVELA_BUILD_TOOLS=OFF $(CMAKE_FLAGS)
	cmake --build build-fuzz --target vela_parse_fuzzer -j $(JOBS)
	mkdir -p build-fuzz/corpus build-fuzz/findings
	./build-fuzz/fuzz/vela_parse_fuzzer -max_total_time=$(FUZZ_SECONDS) -timeout=10 -rss_limit_mb=2048 \
	  -max_len=262144 -dict=fuzz/project.dict -artifact_prefix=build-fuzz/findings/ -print_final_stats=1 \
	  build-fuzz/corpus examples/projects

# The random-edit soak's long run in a Release build: SOAK_EDITS random edits,
# in rounds from fresh projects (round r seeded SOAK_SEED + r); prints the
# edits run and every violation with the seed and step that reproduce it.
SOAK_EDITS ?= 100000
SOAK_SEED ?= 1
soak: deps
	$(CONFIGURE)=Release -B build-soak -DVELA_BUILD_BENCH=OFF -DVELA_BUILD_EXAMPLES=OFF -DVELA_BUILD_TOOLS=OFF $(CMAKE_FLAGS)
	cmake --build build-soak --target vela_soak -j $(JOBS)
	./build-soak/tests/commands/soak/vela_soak --edits $(SOAK_EDITS) --seed $(SOAK_SEED)

# No library file includes a header of a layer above its own.
layer-check:
	cmake -DROOT=$(CURDIR) -P cmake/CheckLayers.cmake

# Every installed header compiles on its own.
header-check: deps
	cmake -G Ninja -S tests/headers -B build-headers > /dev/null
	cmake --build build-headers -j $(JOBS)

format:
	clang-format -i $(SOURCES)

format-check: deps
	clang-format --dry-run --Werror $(SOURCES)

# Installs into a scratch prefix and builds a small program against the package config.
install-check: build/build.ninja
	cmake --build build -j $(JOBS)
	rm -rf build/prefix build/consumer
	cmake --install build --prefix $(CURDIR)/build/prefix > /dev/null
	cmake -G Ninja -S tests/install -B build/consumer -DCMAKE_PREFIX_PATH=$(CURDIR)/build/prefix
	cmake --build build/consumer
	./build/consumer/vela-consumer
	PKG_CONFIG_PATH=$(CURDIR)/build/prefix/lib/pkgconfig $(CXX) tests/install/main.cpp -o build/consumer/vela-consumer-pc \
	  $$(PKG_CONFIG_PATH=$(CURDIR)/build/prefix/lib/pkgconfig pkg-config --cflags --libs velamedialib) -Wl,-rpath,$(CURDIR)/build/prefix/lib
	./build/consumer/vela-consumer-pc
