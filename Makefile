# PYRALIS Calculs Topo: the usual commands.
#   make demo    install what is missing, build in Release, run pyralis on the bundled GéoBase and field book
#   make check   install what is missing, build with AddressSanitizer and UBSan, run every test
#   make bench   build in Release and run the benchmarks
#   make fuzz    build the fuzz targets with clang and run each for FUZZ_SECONDS (60) seconds
#   make fiabilite  build in Release and kill pyralis 1 000 times while it saves a 100 000-element GéoBase
#   make bureau  install what is missing, build in Release and open pyralis-bureau on the demo GéoBase
#   make format  apply .clang-format to every source file

JOBS ?= $(shell nproc)
RELEASE_DIR := build/release
CHECK_DIR := build/check
FUZZ_DIR := build/fuzz
FUZZ_SECONDS ?= 60
FUZZ_TARGETS := fuzz_geo_load fuzz_sepcol fuzz_gsi fuzz_quendal fuzz_geodim fuzz_nikon fuzz_sokkia \
	fuzz_topcon fuzz_zeiss fuzz_param_file fuzz_code_table
KILLS ?= 1000
DEMO_DIR := build/demo-out

.PHONY: all deps release demo bureau check bench fuzz fiabilite format clean

all: release

deps:
	@bash scripts/install-deps

release: deps
	cmake -S . -B $(RELEASE_DIR) -G Ninja -DCMAKE_BUILD_TYPE=Release -DPYR_TESTS=OFF -DPYR_BENCH=ON
	cmake --build $(RELEASE_DIR) -j $(JOBS)

# The commands of the module, then the GéoBase editor on a copy of the bundled job, then the orientation
# of every station with its listing, and point 101 computed by intersection from the three stations that
# sight it, written back with its listing, and every other point sighted radiated from the stations; the
# points of the job exported as a delimited text file and as a DXF drawing; then the bundled Quendal-Pc
# field book converted into a new GéoBase
# (its codes interpreted by the default table), whose stations are oriented in turn. The demo has a
# parameter file and a registry of its own (the user's settings are left alone).
demo: release
	@rm -rf $(DEMO_DIR) && mkdir -p $(DEMO_DIR)
	@cp data/chantier-demo.geo $(DEMO_DIR)/
	$(RELEASE_DIR)/bin/pyralis --params $(DEMO_DIR)/Pyralis.ini </dev/null
	$(RELEASE_DIR)/bin/pyralis --params $(DEMO_DIR)/Pyralis.ini GeoEdit --geobase $(DEMO_DIR)/chantier-demo.geo
	$(RELEASE_DIR)/bin/pyralis --params $(DEMO_DIR)/Pyralis.ini --oui CalculV0 \
		--geobase $(DEMO_DIR)/chantier-demo.geo --type toutes --enregistrer --listing $(DEMO_DIR)/chantier-demo.cv0
	@cat $(DEMO_DIR)/chantier-demo.cv0
	$(RELEASE_DIR)/bin/pyralis --params $(DEMO_DIR)/Pyralis.ini --oui CalInter \
		--geobase $(DEMO_DIR)/chantier-demo.geo --point 101 --enregistrer --listing $(DEMO_DIR)/chantier-demo.cin
	@cat $(DEMO_DIR)/chantier-demo.cin
	$(RELEASE_DIR)/bin/pyralis --params $(DEMO_DIR)/Pyralis.ini --oui CalRayon \
		--geobase $(DEMO_DIR)/chantier-demo.geo --type toutes --enregistrer --listing $(DEMO_DIR)/chantier-demo.cpr
	@cat $(DEMO_DIR)/chantier-demo.cpr
	$(RELEASE_DIR)/bin/pyralis --params $(DEMO_DIR)/Pyralis.ini ESeparat --geobase $(DEMO_DIR)/chantier-demo.geo \
		--sortie $(DEMO_DIR)/chantier-demo-points.txt --tous-les-points --remplacer
	@cat $(DEMO_DIR)/chantier-demo-points.txt
	$(RELEASE_DIR)/bin/pyralis --params $(DEMO_DIR)/Pyralis.ini EPoints --format 7 \
		--geobase $(DEMO_DIR)/chantier-demo.geo --tous-les-points --remplacer
	@cp data/carnet-tilleuls.qdl $(DEMO_DIR)/
	PYRALIS_REGISTRE=$(DEMO_DIR)/registre $(RELEASE_DIR)/bin/pyralis --params $(DEMO_DIR)/Pyralis.ini --oui \
		LQuenda $(DEMO_DIR)/carnet-tilleuls.qdl --interpretation 1 </dev/null
	$(RELEASE_DIR)/bin/pyralis --params $(DEMO_DIR)/Pyralis.ini --oui CalculV0 --type toutes --enregistrer \
		--listing $(DEMO_DIR)/carnet-tilleuls.cv0 </dev/null
	@cat $(DEMO_DIR)/carnet-tilleuls.cv0

# The desktop host on a copy of the demo job, with the demo's own parameter file. Without a display it
# says so, and `pyralis-bureau --capture FICHIER.png` still draws its window into an image.
bureau: release
	@mkdir -p $(DEMO_DIR)
	@test -f $(DEMO_DIR)/chantier-demo.geo || cp data/chantier-demo.geo $(DEMO_DIR)/
	$(RELEASE_DIR)/bin/pyralis-bureau --params $(DEMO_DIR)/Pyralis.ini --geobase $(DEMO_DIR)/chantier-demo.geo

check: deps
	cmake -S . -B $(CHECK_DIR) -G Ninja -DCMAKE_BUILD_TYPE=Debug -DPYR_SANITIZE=ON -DPYR_WERROR=ON
	cmake --build $(CHECK_DIR) -j $(JOBS)
	cd $(CHECK_DIR) && ctest --output-on-failure -j $(JOBS)

bench: release
	$(RELEASE_DIR)/bench/pyr_bench --benchmark_counters_tabular=true

fuzz: deps
	@command -v clang++ >/dev/null || { echo "make fuzz : clang++ est introuvable (paquets clang et libclang-rt-dev)."; exit 1; }
	cmake -S . -B $(FUZZ_DIR) -G Ninja -DCMAKE_CXX_COMPILER=clang++ -DCMAKE_BUILD_TYPE=RelWithDebInfo \
		-DPYR_TESTS=OFF -DPYR_FUZZ=ON
	cmake --build $(FUZZ_DIR) -j $(JOBS) --target $(FUZZ_TARGETS)
	bash fuzz/run $(FUZZ_DIR) $(FUZZ_SECONDS) $(FUZZ_TARGETS)

fiabilite: release
	bash tests/kill-save $(RELEASE_DIR)/bin/pyralis $(KILLS)

format:
	git ls-files '*.cpp' '*.h' | xargs clang-format -i

clean:
	rm -rf build
