# kv_options: what every target of the project is compiled and linked with.
add_library(kv_options INTERFACE)
# What Boost.Python includes of Boost is called deprecated by Boost itself.
target_compile_definitions(kv_options INTERFACE BOOST_ALLOW_DEPRECATED_HEADERS BOOST_BIND_GLOBAL_PLACEHOLDERS)
target_compile_options(kv_options INTERFACE -Wall -Wextra -Wpedantic -Wshadow)
# A library calls its own functions straight, also those that it exports, and the compiler may inline them.
target_compile_options(kv_options INTERFACE -fno-semantic-interposition)
if(KV_SANITIZE)
  # Boost.Python asks the holder of an instance for its type when it has destroyed it, which the check of virtual tables
  # does not survive.
  target_compile_options(kv_options INTERFACE -fsanitize=address,undefined -fno-sanitize=vptr
                                              -fno-sanitize-recover=undefined -fno-omit-frame-pointer)
  target_link_options(kv_options INTERFACE -fsanitize=address,undefined)
endif()

# kv_python: Python for libraries, which find the interpreter in the process that loads them.
add_library(kv_python INTERFACE)
target_link_libraries(kv_python INTERFACE Boost::python Python3::Module)

# kv_install(NAME PLACE): installs a target at a place in the tree. There, as in the build tree, it finds the host's
# libraries from where it stands itself.
function(kv_install name place)
  set(found $ORIGIN)
  file(RELATIVE_PATH libraries /${place} /${KV_LIBRARY_PLACE})
  if(libraries)
    list(APPEND found $ORIGIN/${libraries})
  endif()
  set_target_properties(${name} PROPERTIES BUILD_WITH_INSTALL_RPATH ON INSTALL_RPATH "${found}")
  install(TARGETS ${name} DESTINATION ${place})
endfunction()

# kv_library(NAME SOURCES... [DEPENDS rooms...] [PUBLIC targets...] [PRIVATE targets...] [OWN_RECORD] [MODULE]): a host or sibling
# library, lib<NAME>.so. Its folder is the include folder for those that link it. It is a package by the name without
# KV. Its record names the libraries of DEPENDS in their order; one with OWN_RECORD makes it itself. A MODULE is installed
# by its own rule.
function(kv_library name)
  cmake_parse_arguments(PARSE_ARGV 1 arg "OWN_RECORD;MODULE" "" "SOURCES;DEPENDS;PUBLIC;PRIVATE")
  add_library(${name} SHARED ${arg_SOURCES})
  target_link_libraries(${name} PUBLIC ${arg_DEPENDS} ${arg_PUBLIC} PRIVATE kv_options ${arg_PRIVATE})
  target_include_directories(${name} PUBLIC ${CMAKE_CURRENT_SOURCE_DIR})
  if(NOT KV_SANITIZE AND NOT kv_python IN_LIST arg_PUBLIC AND NOT kv_python IN_LIST arg_PRIVATE)
    target_link_options(${name} PRIVATE -Wl,--no-undefined)
  endif()
  set_target_properties(${name} PROPERTIES LIBRARY_OUTPUT_DIRECTORY ${KV_LIBRARY_DIR})
  if(NOT arg_MODULE)
    kv_install(${name} ${KV_LIBRARY_PLACE})
  endif()
  if(NOT arg_OWN_RECORD)
    set(record ${PROJECT_SOURCE_DIR}/host/base/packages/inPackageRecord.cpp)
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
  kv_library(${name} ${ARGN} PUBLIC kv_python MODULE)
  set_target_properties(${name} PROPERTIES LIBRARY_OUTPUT_DIRECTORY ${KV_PACKAGE_DIR}/quorvane_velmora/libs)
  kv_install(${name} ${KV_PACKAGE_PLACE}/quorvane_velmora/libs)
endfunction()
