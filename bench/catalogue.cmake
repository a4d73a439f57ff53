pigmo_add_bench(catalogue_bench SOURCES CatalogueBench.cpp LIBS pigmo_api)
