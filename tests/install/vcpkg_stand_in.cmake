# Runs the vcpkg port with stand-ins for vcpkg's own functions, for machines without vcpkg: the calls,
# paths and names of the port are tried, vcpkg itself is not.
#
#     cmake -DPORT_DIR=... -DOUT=... -DVERSION=... -DSHARED=ON|OFF -P vcpkg_stand_in.cmake
cmake_minimum_required(VERSION 3.25)

set(PORT voreleffect)
set(CURRENT_PORT_DIR ${PORT_DIR})
set(CURRENT_PACKAGES_DIR ${OUT}/package)

macro(run)
  execute_process(COMMAND ${ARGN} OUTPUT_QUIET COMMAND_ERROR_IS_FATAL ANY)
endmacro()

function(vcpkg_cmake_configure)
  cmake_parse_arguments(PARSE_ARGV 0 arg "" SOURCE_PATH OPTIONS)
  run(${CMAKE_COMMAND} -S ${arg_SOURCE_PATH} -B ${OUT}/build -G Ninja -DCMAKE_BUILD_TYPE=Release
    -DBUILD_SHARED_LIBS=${SHARED} -DCMAKE_INSTALL_PREFIX=${CURRENT_PACKAGES_DIR} ${arg_OPTIONS})
endfunction()

function(vcpkg_cmake_install)
  run(${CMAKE_COMMAND} --build ${OUT}/build --target install)
endfunction()

function(vcpkg_cmake_config_fixup)
  cmake_parse_arguments(PARSE_ARGV 0 arg "" CONFIG_PATH "")
  file(MAKE_DIRECTORY ${CURRENT_PACKAGES_DIR}/share)
  file(RENAME ${CURRENT_PACKAGES_DIR}/${arg_CONFIG_PATH} ${CURRENT_PACKAGES_DIR}/share/${PORT})
endfunction()

function(vcpkg_fixup_pkgconfig)
  run(pkg-config --exists --print-errors ${CURRENT_PACKAGES_DIR}/lib/pkgconfig/${PORT}.pc)
endfunction()

function(vcpkg_install_copyright)
  cmake_parse_arguments(PARSE_ARGV 0 arg "" "" FILE_LIST)
  configure_file(${arg_FILE_LIST} ${CURRENT_PACKAGES_DIR}/share/${PORT}/copyright COPYONLY)
endfunction()

include(${PORT_DIR}/portfile.cmake)

file(READ ${PORT_DIR}/vcpkg.json manifest)
string(JSON version GET ${manifest} version-semver)
if(NOT version STREQUAL VERSION)
  message(FATAL_ERROR "vcpkg.json has version ${version}, not ${VERSION}")
endif()

set(library libvoreleffect.a)
if(SHARED)
  set(library libvoreleffect.so)
endif()
foreach(file include/voreleffect/voreleffect.h lib/${library} share/voreleffect/copyright
    share/voreleffect/usage share/voreleffect/voreleffect-config.cmake)
  if(NOT EXISTS ${CURRENT_PACKAGES_DIR}/${file})
    message(FATAL_ERROR "the vcpkg package has no ${file}")
  endif()
endforeach()
