# Imported target Pigmo::pigmo for find_package(Pigmo); paths are relative to this file.
get_filename_component(_pigmo_prefix "${CMAKE_CURRENT_LIST_DIR}/../../.." ABSOLUTE)
if(NOT TARGET Pigmo::pigmo)
  add_library(Pigmo::pigmo SHARED IMPORTED)
  set_target_properties(Pigmo::pigmo PROPERTIES
    IMPORTED_LOCATION "${_pigmo_prefix}/lib/libpigmo.so"
    INTERFACE_INCLUDE_DIRECTORIES "${_pigmo_prefix}/include"
    INTERFACE_COMPILE_FEATURES cxx_std_20)
endif()
set(Pigmo_FOUND TRUE)
unset(_pigmo_prefix)
