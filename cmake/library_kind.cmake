# Shared or static, by CMake's own option; shared unless the user, or the project that this one is part
# of, says otherwise.
if(PROJECT_IS_TOP_LEVEL)
  option(BUILD_SHARED_LIBS "Build a shared library; OFF builds a static one" ON)
elseif(NOT DEFINED BUILD_SHARED_LIBS)
  set(BUILD_SHARED_LIBS ON)
endif()

if(NOT BUILD_SHARED_LIBS)
  # Said for every target here, so that all parts of the library see the same headers.
  add_compile_definitions(VOREL_STATIC)
endif()

# What the users of the library must be told, if it is static: a shared one names itself what it needs.
function(vorel_library_kind target)
  if(NOT BUILD_SHARED_LIBS)
    target_compile_definitions(${target} INTERFACE VOREL_STATIC)
    target_link_libraries(${target} PRIVATE m)
  endif()
endfunction()
