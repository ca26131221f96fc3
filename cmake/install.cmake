# What `cmake --install` lays down, in four components: runtime (the shared library), development
# (headers, link name or static library, package files), tool (tools/vorelpaint/CMakeLists.txt) and python
# (bindings/python/CMakeLists.txt).
include(CMakePackageConfigHelpers)
include(GNUInstallDirs)

install(TARGETS voreleffect EXPORT voreleffect-targets
  LIBRARY COMPONENT runtime NAMELINK_COMPONENT development
  ARCHIVE COMPONENT development
  INCLUDES DESTINATION ${CMAKE_INSTALL_INCLUDEDIR})
install(DIRECTORY include/voreleffect TYPE INCLUDE COMPONENT development)

# What of the C++ runtime a program must link that is linked by a C compiler with the static library.
set(VOREL_CXX_RUNTIME ${CMAKE_CXX_IMPLICIT_LINK_LIBRARIES})
list(FILTER VOREL_CXX_RUNTIME INCLUDE REGEX "^(stdc\\+\\+|c\\+\\+|c\\+\\+abi)$")
list(REMOVE_DUPLICATES VOREL_CXX_RUNTIME)

# find_package(voreleffect)
set(VOREL_CONFIG_DIR ${CMAKE_INSTALL_LIBDIR}/cmake/voreleffect)
configure_package_config_file(cmake/voreleffect-config.cmake.in
  ${PROJECT_BINARY_DIR}/voreleffect-config.cmake
  INSTALL_DESTINATION ${VOREL_CONFIG_DIR}
  NO_SET_AND_CHECK_MACRO)
write_basic_package_version_file(${PROJECT_BINARY_DIR}/voreleffect-config-version.cmake
  COMPATIBILITY SameMajorVersion)
install(EXPORT voreleffect-targets NAMESPACE voreleffect::
  DESTINATION ${VOREL_CONFIG_DIR} COMPONENT development)
install(FILES
  ${PROJECT_BINARY_DIR}/voreleffect-config.cmake
  ${PROJECT_BINARY_DIR}/voreleffect-config-version.cmake
  DESTINATION ${VOREL_CONFIG_DIR} COMPONENT development)

# pkg-config: the file finds the prefix from its own place, so the installed tree may be moved.
set(VOREL_PC_DIR ${CMAKE_INSTALL_FULL_LIBDIR}/pkgconfig)
cmake_path(RELATIVE_PATH CMAKE_INSTALL_PREFIX BASE_DIRECTORY ${VOREL_PC_DIR} OUTPUT_VARIABLE VOREL_PC_PREFIX)
# A directory that was chosen as an absolute path stays one.
set(VOREL_PC_LIBDIR ${CMAKE_INSTALL_LIBDIR})
set(VOREL_PC_INCLUDEDIR ${CMAKE_INSTALL_INCLUDEDIR})
foreach(directory VOREL_PC_LIBDIR VOREL_PC_INCLUDEDIR)
  if(NOT IS_ABSOLUTE ${${directory}})
    string(PREPEND ${directory} "\${prefix}/")
  endif()
endforeach()
list(TRANSFORM VOREL_CXX_RUNTIME PREPEND "-l" OUTPUT_VARIABLE VOREL_PC_LIBS_PRIVATE)
list(APPEND VOREL_PC_LIBS_PRIVATE "-lm")
list(JOIN VOREL_PC_LIBS_PRIVATE " " VOREL_PC_LIBS_PRIVATE)
if(ANDROID)
  string(APPEND VOREL_PC_LIBS_PRIVATE " -llog")
endif()
set(VOREL_PC_CFLAGS "")
if(NOT BUILD_SHARED_LIBS)
  set(VOREL_PC_CFLAGS " -DVOREL_STATIC")
endif()
configure_file(cmake/voreleffect.pc.in ${PROJECT_BINARY_DIR}/voreleffect.pc @ONLY)
install(FILES ${PROJECT_BINARY_DIR}/voreleffect.pc
  DESTINATION ${CMAKE_INSTALL_LIBDIR}/pkgconfig COMPONENT development)
