# kv_options: what every target of the project is compiled and linked with.
add_library(kv_options INTERFACE)
# What Boost.Python includes of Boost is called deprecated by Boost itself.
target_compile_definitions(kv_options INTERFACE BOOST_ALLOW_DEPRECATED_HEADERS BOOST_BIND_GLOBAL_PLACEHOLDERS)
target_compile_options(kv_options INTERFACE -Wall -Wextra -Wpedantic -Wshadow)
# A library calls its own functions straight, also those that it exports, and the compiler may inline them.
target_compile_options(kv_options INTERFACE -fno-semantic-interposition)
if(KV_SANITIZE STREQUAL thread)
  target_compile_options(kv_options INTERFACE -fsanitize=thread)
  target_link_options(kv_options INTERFACE -fsanitize=thread)
elseif(KV_SANITIZE)
  # Boost.Python asks the holder of an instance for its type when it has destroyed it, which the check of virtual tables
  # does not survive.
  target_compile_options(kv_options INTERFACE -fsanitize=address,undefined -fno-sanitize=vptr
                                              -fno-sanitize-recover=undefined -fno-omit-frame-pointer)
  target_link_options(kv_options INTERFACE -fsanitize=address,undefined)
endif()
if(KV_FUZZ)
  target_compile_options(kv_options INTERFACE -fsanitize=fuzzer-no-link -fno-sanitize=function -Wno-return-type-c-linkage)
endif()

# kv_python: Python for libraries, which find the interpreter in the process that loads them.
add_library(kv_python INTERFACE)
target_link_libraries(kv_python INTERFACE Boost::python Python3::Module)
install(TARGETS kv_python EXPORT velmora)

# kv_place(NAME PLACE [EXPORT velmora]): gives a target its place, in the build tree and in the installed one. In both it
# finds the host's libraries from where it stands itself.
function(kv_place name place)
  set(found $ORIGIN)
  file(RELATIVE_PATH libraries /${place} /${KV_LIBRARY_PLACE})
  if(libraries)
    list(APPEND found $ORIGIN/${libraries})
  endif()
  set_target_properties(${name} PROPERTIES
    BUILD_WITH_INSTALL_RPATH ON INSTALL_RPATH "${found}"
    LIBRARY_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/${place} RUNTIME_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/${place})
  install(TARGETS ${name} ${ARGN} DESTINATION ${place})
endfunction()

# kv_headers(NAME KIND FOLDER): the folder whose headers are for those that link the target. The installed tree has a copy.
function(kv_headers name kind folder)
  target_include_directories(${name} ${kind} $<BUILD_INTERFACE:${CMAKE_CURRENT_SOURCE_DIR}/${folder}>
                                             $<INSTALL_INTERFACE:${KV_HEADER_PLACE}/${name}>)
  install(DIRECTORY ${folder}/ DESTINATION ${KV_HEADER_PLACE}/${name} FILES_MATCHING PATTERN "*.h")
endfunction()

# kv_library(NAME SOURCES... [DEPENDS rooms...] [PUBLIC targets...] [PRIVATE targets...] [OWN_RECORD] [INTERNAL]
# [PLACE place] [HEADERS folder]): a host or sibling library, lib<NAME>.so, at KV_LIBRARY_PLACE if not told otherwise. Its
# folder, or that of HEADERS, has the headers for those that link it. It is a package by the name without KV. Its record
# names the libraries of DEPENDS in their order; one with OWN_RECORD makes it itself. One that is INTERNAL is not for
# programs outside the project.
function(kv_library name)
  cmake_parse_arguments(PARSE_ARGV 1 arg "OWN_RECORD;INTERNAL" "PLACE;HEADERS" "SOURCES;DEPENDS;PUBLIC;PRIVATE")
  add_library(${name} SHARED ${arg_SOURCES})
  target_link_libraries(${name} PUBLIC ${arg_DEPENDS} ${arg_PUBLIC} PRIVATE kv_options ${arg_PRIVATE})
  if(NOT KV_SANITIZE AND NOT kv_python IN_LIST arg_PUBLIC AND NOT kv_python IN_LIST arg_PRIVATE)
    target_link_options(${name} PRIVATE -Wl,--no-undefined)
  endif()
  if(NOT arg_PLACE)
    set(arg_PLACE ${KV_LIBRARY_PLACE})
  endif()
  if(arg_INTERNAL)
    target_include_directories(${name} PUBLIC ${CMAKE_CURRENT_SOURCE_DIR})
    kv_place(${name} ${arg_PLACE})
  else()
    if(NOT arg_HEADERS)
      set(arg_HEADERS .)
    endif()
    kv_headers(${name} PUBLIC ${arg_HEADERS})
    kv_place(${name} ${arg_PLACE} EXPORT velmora)
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
  kv_library(${name} ${ARGN} PUBLIC kv_python PLACE ${KV_PACKAGE_PLACE}/quorvane_velmora/libs)
endfunction()
