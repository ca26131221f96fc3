# Packages by CPack, one a component; scripts/debian.sh builds the Debian ones.
set(CPACK_PACKAGE_VENDOR "voreleffect maintainers")
set(CPACK_PACKAGE_CONTACT "voreleffect maintainers <maintainers@voreleffect.example>")
set(CPACK_RESOURCE_FILE_LICENSE ${PROJECT_SOURCE_DIR}/LICENSE)
set(CPACK_RESOURCE_FILE_README ${PROJECT_SOURCE_DIR}/README.md)
set(CPACK_STRIP_FILES ON)
set(CPACK_GENERATOR DEB)

set(CPACK_COMPONENTS_ALL runtime development)
if(VOREL_BUILD_TOOLS)
  list(APPEND CPACK_COMPONENTS_ALL tool)
endif()
if(VOREL_BUILD_PYTHON)
  list(APPEND CPACK_COMPONENTS_ALL python)
endif()

set(CPACK_DEB_COMPONENT_INSTALL ON)
set(CPACK_DEBIAN_FILE_NAME DEB-DEFAULT)
set(CPACK_DEBIAN_PACKAGE_CONTROL_STRICT_PERMISSION ON)
set(CPACK_INSTALL_DEFAULT_DIRECTORY_PERMISSIONS
  OWNER_READ OWNER_WRITE OWNER_EXECUTE GROUP_READ GROUP_EXECUTE WORLD_READ WORLD_EXECUTE)

# What other libraries a package needs is read from its programs. Of its own library, which is not
# installed while the tool is packed, that tells nothing.
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS ON)
set(CPACK_DEBIAN_PACKAGE_SHLIBDEPS_PRIVATE_DIRS ${PROJECT_BINARY_DIR})
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS ON)
set(CPACK_DEBIAN_PACKAGE_GENERATE_SHLIBS_POLICY ">=")
set(CPACK_DEBIAN_RUNTIME_PACKAGE_CONTROL_EXTRA ${PROJECT_SOURCE_DIR}/packaging/debian/triggers)
set(runtime libvoreleffect${VOREL_ABI})
set(CPACK_DEBIAN_DEVELOPMENT_PACKAGE_DEPENDS "${runtime} (= ${PROJECT_VERSION})")
# ffmpeg is run for films; nothing that is read from the program tells so.
set(CPACK_DEBIAN_TOOL_PACKAGE_DEPENDS "${runtime} (>= ${PROJECT_VERSION}), ffmpeg")
set(CPACK_DEBIAN_TOOL_PACKAGE_RECOMMENDS fonts-dejavu-core)
# The module has the library in it. It is for the one minor version of Python that it was built for.
if(VOREL_BUILD_PYTHON)
  math(EXPR next "${Python3_VERSION_MINOR} + 1")
  set(CPACK_DEBIAN_PYTHON_PACKAGE_DEPENDS "python3 (>= 3.${Python3_VERSION_MINOR}), python3 (<< 3.${next}), \
python3-numpy")
  set(CPACK_DEBIAN_PYTHON_PACKAGE_RECOMMENDS "python3-pil, fonts-dejavu-core")
  set(CPACK_DEBIAN_PYTHON_PACKAGE_CONTROL_EXTRA
    ${PROJECT_SOURCE_DIR}/packaging/debian/python/postinst ${PROJECT_SOURCE_DIR}/packaging/debian/python/prerm)
endif()

set(about "voreleffect paints strokes, shadows, glows, gradients and patterns\naround and into \
text, from 8-bit coverage masks of its glyphs to\npremultiplied RGBA pixels, the same bytes on every \
CPU.\n\n")

# The first line of a description is the summary: no common one stands before it.
set(CPACK_PACKAGE_DESCRIPTION_SUMMARY "")

# vorel_deb COMPONENT PACKAGE SECTION SUMMARY CONTENTS
function(vorel_deb component package section summary contents)
  set(CPACK_DEBIAN_${component}_PACKAGE_NAME ${package} PARENT_SCOPE)
  set(CPACK_DEBIAN_${component}_PACKAGE_SECTION ${section} PARENT_SCOPE)
  set(CPACK_DEBIAN_${component}_DESCRIPTION "${summary}\n${about}${contents}" PARENT_SCOPE)
endfunction()
vorel_deb(RUNTIME ${runtime} libs "text effects from glyph masks - shared library"
  "This package has the shared library.")
vorel_deb(DEVELOPMENT libvoreleffect-dev libdevel "text effects from glyph masks - development files"
  "This package has the headers and the files for CMake and pkg-config.")
vorel_deb(TOOL vorelpaint graphics "paint text with effects into a PNG file"
  "This package has vorelpaint, which paints a text in a font and a\nstyle, its preset styles, its manual page and documents.")

vorel_deb(PYTHON python3-voreleffect python "text effects from glyph masks - Python package"
  "This package has the package voreleffect of Python, which paints masks\nand texts into arrays of numpy and images of Pillow, and its preset\nstyles.")

# Every Debian package has its copyright and its changes.
set(CPACK_PRE_BUILD_SCRIPTS ${PROJECT_SOURCE_DIR}/cmake/debian_docs.cmake)
include(CPack)
