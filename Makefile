# What one does with the project from its root, on Debian 12. All but `build` first install what is missing.
SHELL := /bin/bash
LAB := verification/lab
JOBS := $(shell nproc)
FUZZ_SECONDS ?= 600
MONKEY_EVENTS ?= 1000000
MONKEY_SEED ?= 2

PROGRAM := wifi-profile wifi-profile-service wifi-profile-extension
# What `tv` adds to `run`.
GROUP :=
MODULE :=
OPTIONS :=

.PHONY: help run tv test build build-all bench lab fuzz monkey
help:
	@echo "make run      build, and profile this machine's Wi-Fi (without a radio: replay the demo recording)"
	@echo "make tv       build, and choose a network on the television screen: in a window, or on a console's whole screen"
	@echo "make build    build/wifi-profile"
	@echo "make test     all tests but those of the lab"
	@echo "make lab      system tests in a virtual machine with simulated radios"
	@echo "make bench    benchmarks: a table, and build/bench.json"
	@echo "make fuzz     each fuzz target for FUZZ_SECONDS ($(FUZZ_SECONDS))"
	@echo "make monkey   MONKEY_EVENTS ($(MONKEY_EVENTS)) random events against the headless screen, a tenth on the television's"

build:
	@cmake --preset dev > /dev/null
	@cmake --build build -j $(JOBS) --target $(PROGRAM)

# The tests too.
build-all:
	@cmake --preset dev > /dev/null
	@cmake --build build -j $(JOBS)

tv: GROUP := tv
tv: MODULE := wifi-profile-screen-tv
tv: OPTIONS := --list --screen tv
# On a desktop a window, so that the rest of it stays in sight.
tv: export WIFI_PROFILE_TV_SIZE ?= $(if $(DISPLAY)$(WAYLAND_DISPLAY),1280x720)
# Standard output is the result's alone.
run tv:
	@{ verification/install_packages build test $(GROUP) && $(MAKE) -s build PROGRAM="$(PROGRAM) $(MODULE)"; } >&2
	@if compgen -G '/sys/class/ieee80211/*' > /dev/null; then exec build/wifi-profile run $(OPTIONS); \
	else echo "No Wi-Fi radio here: replaying the demo recording 'home'." >&2; \
	exec build/wifi-profile run --demo home $(OPTIONS); fi

test:
	@verification/run_tests

lab:
	@verification/install_packages build test tv lab
	@$(MAKE) -s build
	@cmake --build build -j $(JOBS) --target wifi-profile-screen-tv
	@$(LAB)/setup --uml
	@$(LAB)/run-scenarios; status=$$?; $(LAB)/run-on-console 720p && exit $$status

bench:
	@verification/install_packages build test tv
	@verification/run_bench

fuzz:
	@verification/install_packages build test fuzz
	@verification/run_fuzz $(FUZZ_SECONDS)

monkey:
	@verification/install_packages build test tv
	@cmake --preset dev > /dev/null
	@cmake --build build -j $(JOBS) --target monkey
	@build/monkey --mode stepped --seed $(MONKEY_SEED) --events $(MONKEY_EVENTS)
	@build/monkey --mode threaded --seed $(MONKEY_SEED) --events $(MONKEY_EVENTS)
	@build/monkey --mode television --seed $(MONKEY_SEED) --events $$(($(MONKEY_EVENTS) / 10))
