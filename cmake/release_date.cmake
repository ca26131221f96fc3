# vorel_release_date(VARIABLE VERSION): sets the day on which a version was released, as CHANGELOG.md
# tells it. What is built of one source bears one date, whenever that is.
set(VOREL_CHANGELOG ${CMAKE_CURRENT_LIST_DIR}/../CHANGELOG.md)
function(vorel_release_date variable version)
  string(REPLACE . "\\." pattern ${version})
  file(STRINGS ${VOREL_CHANGELOG} heading
    REGEX "^## ${pattern} .*[0-9][0-9][0-9][0-9]-[0-9][0-9]-[0-9][0-9]")
  if(NOT heading)
    message(FATAL_ERROR "CHANGELOG.md has no section '## ${version} (YEAR-MONTH-DAY)'")
  endif()
  string(REGEX MATCH "[0-9]+-[0-9]+-[0-9]+" day ${heading})
  set(${variable} ${day} PARENT_SCOPE)
endfunction()
