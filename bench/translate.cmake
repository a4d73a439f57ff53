pigmo_add_bench(translate_bench SOURCES ${CMAKE_CURRENT_LIST_DIR}/TranslateBench.cpp LIBS pigmo_engine)
