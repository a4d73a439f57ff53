pigmo_add_bench(api_bench SOURCES ${CMAKE_CURRENT_SOURCE_DIR}/ApiBench.cpp LIBS pigmo_api)
