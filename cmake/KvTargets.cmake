# kv_library(NAME SOURCES... [DEPENDS libraries...] [PRIVATE targets...] [OWN_RECORD]): a host or sibling library,
# lib<NAME>.so, which is a package by the name without KV. Its record names the libraries of DEPENDS in their order; one
# with OWN_RECORD makes it itself.
function(kv_library name)
  cmake_parse_arguments(PARSE_ARGV 1 arg "OWN_RECORD" "" "SOURCES;DEPENDS;PRIVATE")
  add_library(${name} SHARED ${arg_SOURCES})
  target_link_libraries(${name} PUBLIC ${arg_DEPENDS} PRIVATE ${arg_PRIVATE})
  target_include_directories(${name} PUBLIC ${PROJECT_SOURCE_DIR}/host ${PROJECT_SOURCE_DIR}/python)
  set_target_properties(${name} PROPERTIES LIBRARY_OUTPUT_DIRECTORY ${KV_LIBRARY_DIR})
  if(NOT arg_OWN_RECORD)
    set(record ${PROJECT_SOURCE_DIR}/host/base/inPackageRecord.cpp)
    list(TRANSFORM arg_DEPENDS REPLACE "^KV" "")
    list(JOIN arg_DEPENDS "," dependencies)
    string(REGEX REPLACE "^KV" "" package ${name})
    target_sources(${name} PRIVATE ${record})
    set_source_files_properties(${record} PROPERTIES
      COMPILE_DEFINITIONS "KV_PACKAGE_NAME=${package};KV_PACKAGE_DEPENDENCIES=${dependencies}")
  endif()
endfunction()

# kv_python_module(NAME ...): as kv_library, an extension module lib<NAME> of the package.
function(kv_python_module name)
  kv_library(${name} ${ARGN})
  target_link_libraries(${name} PUBLIC Boost::python Python3::Python)
  # Modules that are linked to each other find each other wherever the package lies.
  set_target_properties(${name} PROPERTIES LIBRARY_OUTPUT_DIRECTORY ${KV_PACKAGE_DIR}/quorvane_velmora/libs
                                           BUILD_RPATH "$ORIGIN")
endfunction()
