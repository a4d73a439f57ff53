pigmo_add_bench(ciecam02_bench SOURCES ${CMAKE_CURRENT_LIST_DIR}/Ciecam02Bench.cpp LIBS pigmo_engine)
