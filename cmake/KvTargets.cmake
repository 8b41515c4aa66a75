# kv_library(NAME SOURCES... [DEPENDS targets...] [PRIVATE targets...]): a host or sibling library, lib<NAME>.so.
function(kv_library name)
  cmake_parse_arguments(PARSE_ARGV 1 arg "" "" "SOURCES;DEPENDS;PRIVATE")
  add_library(${name} SHARED ${arg_SOURCES})
  target_link_libraries(${name} PUBLIC ${arg_DEPENDS} PRIVATE ${arg_PRIVATE})
  target_include_directories(${name} PUBLIC ${PROJECT_SOURCE_DIR}/host ${PROJECT_SOURCE_DIR}/python)
  set_target_properties(${name} PROPERTIES LIBRARY_OUTPUT_DIRECTORY ${KV_LIBRARY_DIR})
endfunction()

# kv_python_module(NAME SOURCES... DEPENDS targets...): an extension module lib<NAME> of the package.
function(kv_python_module name)
  kv_library(${name} ${ARGN})
  target_link_libraries(${name} PUBLIC Boost::python Python3::Python)
  # Modules that are linked to each other find each other wherever the package lies.
  set_target_properties(${name} PROPERTIES LIBRARY_OUTPUT_DIRECTORY ${KV_PACKAGE_DIR}/quorvane_velmora/libs
                                           BUILD_RPATH "$ORIGIN")
endfunction()
