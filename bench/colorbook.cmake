pigmo_add_bench(colorbook_bench SOURCES ${CMAKE_CURRENT_LIST_DIR}/ColorBookBench.cpp LIBS pigmo_colorbook)
