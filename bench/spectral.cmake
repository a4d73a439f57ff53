pigmo_add_bench(spectral_bench SOURCES ${CMAKE_CURRENT_LIST_DIR}/SpectralBench.cpp LIBS pigmo_engine)
