# Run by CPack over the installed trees, one a component, before it packs them.
if(NOT CPACK_GENERATOR STREQUAL DEB)
  return()
endif()

set(root ${CMAKE_CURRENT_LIST_DIR}/..)
set(version ${CPACK_PACKAGE_VERSION})

# A Debian changelog names each release and its day; the changes are told in CHANGELOG.md.
include(${root}/cmake/release_date.cmake)
vorel_release_date(day ${version})
execute_process(COMMAND date --utc --rfc-email --date ${day}
  OUTPUT_VARIABLE date OUTPUT_STRIP_TRAILING_WHITESPACE COMMAND_ERROR_IS_FATAL ANY)
set(changelog ${CPACK_TEMPORARY_DIRECTORY}/changelog)
file(WRITE ${changelog} "voreleffect (${version}) unstable; urgency=medium\n
  * Release ${version}.\n
 -- ${CPACK_PACKAGE_CONTACT}  ${date}\n")

foreach(component IN LISTS CPACK_COMPONENTS_ALL)
  string(TOUPPER ${component} name)
  set(docs ${CPACK_TEMPORARY_DIRECTORY}/${component}/usr/share/doc/${CPACK_DEBIAN_${name}_PACKAGE_NAME})
  file(MAKE_DIRECTORY ${docs})
  file(COPY ${root}/packaging/debian/copyright ${root}/NOTICE DESTINATION ${docs})
  # Without the name and the time of the file: the same input, the same bytes.
  execute_process(COMMAND gzip -9nc ${changelog} OUTPUT_FILE ${docs}/changelog.gz
    COMMAND_ERROR_IS_FATAL ANY)
  file(CHMOD ${docs}/copyright ${docs}/NOTICE ${docs}/changelog.gz
    PERMISSIONS OWNER_READ OWNER_WRITE GROUP_READ WORLD_READ)
endforeach()

# Debian keeps manual pages packed.
file(GLOB pages ${CPACK_TEMPORARY_DIRECTORY}/*/usr/share/man/man*/*.[1-9])
foreach(page IN LISTS pages)
  execute_process(COMMAND gzip -9n ${page} COMMAND_ERROR_IS_FATAL ANY)
endforeach()
