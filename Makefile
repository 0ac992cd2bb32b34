# The commands of the project; CMake presets do the work. `make help` lists them.

# In continuous integration the same commands treat warnings as errors.
PRESET ?= $(if $(CI),ci,release)
FUZZ_SECONDS ?= 60
PREFIX ?= /usr/local

BUILD := build/$(PRESET)
PACKAGES := build/package
SUDO := $(if $(filter 0,$(shell id -u)),,sudo)
OUR_SOURCES = $(shell git ls-files '*.cpp' '*.h')
say = @printf '\n== %s\n' "$(1)"

.PHONY: help demo test build bench fuzz asan format lint install package \
    package-check packages packages-develop packages-packaging
.DEFAULT_GOAL := help

help:
	@echo "make demo      build, bake a look-up table, put it on an image, and show files"
	@echo "make test      build and run every test"
	@echo "make bench     build and run the benchmarks"
	@echo "make fuzz      run each fuzz target for FUZZ_SECONDS ($(FUZZ_SECONDS))"
	@echo "make asan      all tests under the address and undefined-behaviour sanitizers"
	@echo "make lint      check format and code;  make format: put the format right"
	@echo "make install   install under PREFIX ($(PREFIX))"
	@echo "make package   Debian packages in $(PACKAGES), looked over by lintian"
	@echo "make package-check   the packages, and a bare Debian 12 that uses them (as root; minutes)"

# Installs the packages of a group that are missing; quick when none is.
define install_packages
	@command -v dpkg-query >/dev/null || { echo "no Debian: install what packages.txt names"; exit 0; }; \
	missing=; for package in $$(awk '$$1 ~ /^($(1))$$/ { print $$2 }' packages.txt); do \
	    dpkg-query -W -f '$${Status}' $$package 2>/dev/null | grep -q 'install ok installed' \
	        || missing="$$missing $$package"; \
	done; \
	if [ -n "$$missing" ]; then \
	    printf '\n== installing:%s\n' "$$missing"; \
	    $(SUDO) apt-get update -qq && \
	    $(SUDO) env DEBIAN_FRONTEND=noninteractive apt-get install -y -qq --no-install-recommends $$missing; \
	fi
endef

packages:
	$(call install_packages,build)

packages-develop:
	$(call install_packages,build|develop)

packages-packaging:
	$(call install_packages,build|packaging)

build: packages
	$(call say,building ($(BUILD)))
	@[ -f $(BUILD)/build.ninja ] || cmake --preset $(PRESET)
	@cmake --build $(BUILD)

test: build
	$(call say,testing)
	@ctest --test-dir $(BUILD) --output-on-failure -j 2
	@echo "== all tests passed"

DEMO := build/demo
ORLITH := $(BUILD)/bin/orlith

demo: build
	@mkdir -p $(DEMO)
	$(call say,the look of an image program as a look-up table)
	$(ORLITH) bake $(DEMO)/baked.cube -- oiiotool {in} --powc 0.45 --mulc 0.9,1,0.8 -o {out}
	$(call say,that table on an image)
	oiiotool --pattern fill:topleft=0.02,0.05,0.3:topright=0.5,0.7,1:bottomleft=0.2,0.1,0.05:bottomright=1,0.6,0.2 \
	    640x360 3 -d half -o $(DEMO)/plate.exr
	$(ORLITH) apply $(DEMO)/plate.exr $(DEMO)/plate-graded.exr --lut $(DEMO)/baked.cube --mode tetrahedral
	$(call say,the same look in steps: a 33-point test pattern)
	$(ORLITH) pattern $(DEMO)/pattern.exr --size 33
	$(call say,graded by an image program)
	oiiotool $(DEMO)/pattern.exr --powc 0.45 --mulc 0.9,1,0.8 -o $(DEMO)/graded.exr
	$(call say,read back as look-up tables)
	$(ORLITH) generate $(DEMO)/graded.exr $(DEMO)/look.cube
	$(ORLITH) generate $(DEMO)/graded.exr $(DEMO)/look.3dl
	@for file in $(DEMO)/look.cube $(DEMO)/look.3dl; do \
	    printf '\n== %s\n' $$file; head -n 8 $$file | cut -c 1-100; echo ...; tail -n 2 $$file; \
	done
	@echo && echo "== done: the files are in $(DEMO)"

bench: packages
	@[ -f build/bench/build.ninja ] || cmake --preset bench
	@cmake --build build/bench
	@for program in build/bench/bench/orlith_bench_*; do \
	    [ -x $$program ] && $$program --benchmark_counters_tabular=true; done

fuzz: packages-develop
	@[ -f build/fuzz/build.ninja ] || cmake --preset fuzz
	@cmake --build build/fuzz
	@fuzz/run build/fuzz/fuzz $(FUZZ_SECONDS)

asan: packages
	$(call say,building with sanitizers)
	@[ -f build/asan/build.ninja ] || cmake --preset asan
	@cmake --build build/asan
	@ctest --test-dir build/asan --output-on-failure -j 2

format: packages-develop
	clang-format -i $(OUR_SOURCES)

# The page's scripts share one scope, so they are checked as one. A Node.js that is not Debian's does
# not find Debian's modules by itself.
lint: PAGE = $(BUILD)/page.js
lint: packages-develop
	$(call say,checking format)
	@clang-format --dry-run -Werror $(OUR_SOURCES)
	$(call say,checking code)
	@[ -f $(BUILD)/build.ninja ] || cmake --preset $(PRESET)
	@printf '%s\n' $(filter-out fuzz/% bench/%,$(filter %.cpp,$(OUR_SOURCES))) \
	    | xargs -P 2 -n 4 clang-tidy --quiet -p $(BUILD) 2>/dev/null
	$(call say,checking the page)
	@cat report/page/*.js > $(PAGE)
	@NODE_PATH=/usr/share/nodejs eslint --no-eslintrc --config report/page/eslint.json --format unix $(PAGE)

install: build
	cmake --install $(BUILD) --prefix $(PREFIX)

# Dated by the last commit, so that the same source gives the same documents.
package: packages-packaging
	$(call say,building packages ($(PACKAGES)))
	@export SOURCE_DATE_EPOCH=$$(git log -1 --format=%ct) && cmake --preset package
	@cmake --build $(PACKAGES)
	@rm -f $(PACKAGES)/*.deb
	@cd $(PACKAGES) && cpack
	$(call say,checking packages)
	@lintian --fail-on error --suppress-tags initial-upload-closes-no-bugs $(PACKAGES)/*.deb

package-check: package
	$(call say,using the packages in a bare Debian)
	@$(SUDO) packaging/check $(PACKAGES)
