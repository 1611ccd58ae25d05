# One word for each thing a person does; `make help` lists them.
JOBS ?= $(shell nproc)
BUILD := build/release
CMAKE_BUILD = cmake --build --preset $(1) --parallel $(JOBS)

.DEFAULT_GOAL := build
.PHONY: help setup build demo test sanitize threads windows automation dist delphi bench bench-windows format layout \
	tidy docs install clean

help: ## this list
	@sed -n 's/^\([a-z-]*\):.*## /\1\t/p' $(MAKEFILE_LIST) | expand -t 16

setup: ## install what is missing (Debian packages), saying what it does
	@scripts/setup

build: $(BUILD)/CMakeCache.txt ## build the library, the tool and the tests into build/release
	@$(call CMAKE_BUILD,release)

$(BUILD)/CMakeCache.txt: CMakePresets.json
	@scripts/setup
	@cmake --preset release

demo: setup build ## build what is missing, summarise the sample inbox, show the doctor's page and a whole repair job
	@$(BUILD)/tools/varnex3 scan samples/inbox; test $$? -le 1
	@echo; $(BUILD)/tools/varnex3 doctor; test $$? -le 1
	@echo; PYTHONPATH=bindings/python python3 -B samples/python/repair_job.py samples/messages

test: setup build windows ## build everything and run every test, those of the component with automation hosts under Wine
	@scripts/setup samples
	@scripts/run_tests $(BUILD) build/win32 build/win64

automation: windows ## build the component and run its tests alone
	@scripts/run_tests build/win32 build/win64

sanitize: setup ## build with the address and undefined-behaviour sanitizers and run every test
	@cmake --preset asan
	@$(call CMAKE_BUILD,asan)
	@scripts/run_tests build/asan

threads: setup ## build with the thread sanitizer and run the tests of the database access
	@cmake --preset tsan
	@$(call CMAKE_BUILD,tsan) --target varnex3_test_services
	@scripts/run_tests build/tsan services

windows: build ## build the component for 32-bit and 64-bit Windows into build/win32 and build/win64
	@scripts/setup windows
	@for bits in win32 win64; do cmake --preset $$bits && $(call CMAKE_BUILD,$$bits) || exit; done

dist: build windows ## the zip for Windows and the Debian packages, into build/dist
	@rm -rf build/dist
	@scripts/make_dist windows build/win32 build/win64 build/dist
	@scripts/make_dist debian $(BUILD) build/dist
	@ls -l build/dist

delphi: ## compile the Delphi samples for Windows into build/delphi (once: some minutes, 420 MB)
	@tests/dist/compile_delphi build/delphi

bench: setup ## measure against the peers, print the ratios
	@scripts/setup bench
	@cmake --preset bench
	@$(call CMAKE_BUILD,bench)
	@benchmarks/run build/bench

bench-windows: windows ## measure what the component costs its hosts
	@benchmarks/windows/run build/win32 build/win64

format: ## lay out every C++ file
	@scripts/setup tidy
	@scripts/sources | xargs clang-format -i

layout: ## check that every C++ file is laid out as `make format` would
	@scripts/setup tidy
	@scripts/sources | xargs clang-format --dry-run -Werror

tidy: setup layout ## the same, and every source file through clang-tidy
	@cmake --preset tidy
	@$(call CMAKE_BUILD,tidy)

docs: build ## write the reference, a page for each class, into build/docs/reference
	@PYTHONPATH=bindings/python python3 -B scripts/make_reference build/docs/reference

install: build ## install under PREFIX (default: /usr/local)
	@cmake --install $(BUILD) $(if $(PREFIX),--prefix $(PREFIX))

clean: ## remove what was built
	@rm -rf build bindings/python/varnex3/*.so bindings/python/varnex3/*.pyi
