# make run: build and run the host application on its embedded default settings.
# make test: build and pass every test.   make bench: build and run the benchmarks.
BUILD ?= build
TYPE ?= RelWithDebInfo
SANITIZE ?= OFF
JOBS ?= 2
CMAKE_FLAGS = -DCMAKE_BUILD_TYPE=$(TYPE) -DZEP_SANITIZE=$(SANITIZE)

.PHONY: deps configure run test bench clean

deps:
	@./scripts/install-deps

configure: deps
	@cmake -S . -B $(BUILD) $(CMAKE_FLAGS) >/dev/null

run: configure
	@cmake --build $(BUILD) -j $(JOBS) --target drafting-options
	@$(BUILD)/app/drafting-options

test: configure
	@cmake --build $(BUILD) -j $(JOBS)
	@cd $(BUILD) && ctest --output-on-failure -j $(JOBS)

bench: deps
	@./scripts/install-bench-deps
	@cmake -S . -B build-bench -DCMAKE_BUILD_TYPE=Release -DZEP_BUILD_BENCH=ON >/dev/null
	@cmake --build build-bench -j $(JOBS) --target zep_bench
	@build-bench/bench/zep_bench --benchmark_repetitions=5 --benchmark_enable_random_interleaving=true --benchmark_report_aggregates_only=true

clean:
	rm -rf build build-asan build-bench
