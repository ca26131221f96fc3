# The numbers of the library; the header is the source of its version.
set(VOREL_VERSION_HEADER ${CMAKE_CURRENT_LIST_DIR}/../include/voreleffect/VFVersion.h)
set_property(DIRECTORY APPEND PROPERTY CMAKE_CONFIGURE_DEPENDS ${VOREL_VERSION_HEADER})
file(STRINGS ${VOREL_VERSION_HEADER} VOREL_VERSION
  REGEX "^#define VOREL_VERSION_(MAJOR|MINOR|PATCH) [0-9]+$")
list(TRANSFORM VOREL_VERSION REPLACE "^.* " "")
list(JOIN VOREL_VERSION "." VOREL_VERSION)

# The number of the binary interface, in the SONAME and in the name of the Debian package. It grows by
# one when a compiled program would break: a symbol, a slot or a field is gone or has moved. It counts
# apart from the version, most of whose steps break nothing.
set(VOREL_ABI 1)
