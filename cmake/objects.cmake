include(CheckCXXSymbolExists)
check_cxx_symbol_exists(__i386__ cstddef VOREL_FOR_I386)
check_cxx_symbol_exists(__wasm__ cstddef VOREL_FOR_WASM)
# A WebAssembly module stands at its own place in memory.
set(VOREL_RELOCATABLE ON)
if(VOREL_FOR_WASM)
  set(VOREL_RELOCATABLE OFF)
endif()

# How every source of the library is compiled.
function(vorel_objects target)
  target_include_directories(${target} PRIVATE
    ${PROJECT_SOURCE_DIR} ${PROJECT_SOURCE_DIR}/include)
  target_compile_features(${target} PRIVATE cxx_std_17)
  # Without contraction no product and sum fuse into one rounding: every CPU paints the same bytes.
  # Nor does a build that asks for fast arithmetic get it: core/strict_math.h.
  target_compile_options(${target} PRIVATE -fno-exceptions -ffp-contract=off -fno-fast-math)
  if(VOREL_FOR_I386)
    # The old floating-point registers of 32-bit x86 would keep more than single precision.
    target_compile_options(${target} PRIVATE -msse2 -mfpmath=sse)
  endif()
  # Nothing takes the place of the library's own functions, and linkers may fold them.
  target_compile_options(${target} PRIVATE
    $<$<NOT:$<BOOL:${VOREL_FOR_WASM}>>:-fno-semantic-interposition> -ffunction-sections -fdata-sections)
  # Beyond this level compilers unroll loops that are vectors already: half the size again, no speed.
  target_compile_options(${target} PRIVATE $<$<CONFIG:Release>:-O2>)
  if(VOREL_ASSERTIONS)
    target_compile_definitions(${target} PRIVATE VOREL_ASSERTIONS=1)
  endif()
  vorel_warnings(${target})
  set_target_properties(${target} PROPERTIES
    CXX_EXTENSIONS OFF
    CXX_VISIBILITY_PRESET hidden
    VISIBILITY_INLINES_HIDDEN ON
    POSITION_INDEPENDENT_CODE ${VOREL_RELOCATABLE})
endfunction()

# vorel_strict_link(TARGET): some linkers' drivers answer a wish for fast arithmetic with code that, when
# the shared library is loaded, lets the whole process flush subnormal numbers. Not for this one.
function(vorel_strict_link target)
  target_link_options(${target} PRIVATE -O2 -fno-fast-math -fno-unsafe-math-optimizations)
endfunction()

# vorel_small_link(TARGET): a shared library without what its linker can leave out. Functions of equal
# instructions are one where it folds them, as Android's does. Code and constants share a segment: one apart
# would begin on a page of its own, of 16 KB. Names have one table, but on Android, which reads the newer
# kind from API 23 on. What the library calls of its own is not looked up by name.
include(CheckLinkerFlag)
check_linker_flag(CXX -Wl,--icf=all VOREL_LINKER_FOLDS)
check_linker_flag(CXX -Wl,-z,noseparate-code VOREL_LINKER_JOINS)
function(vorel_small_link target)
  target_link_options(${target} PRIVATE -Wl,-Bsymbolic-functions)
  if(VOREL_LINKER_FOLDS)
    target_link_options(${target} PRIVATE -Wl,--icf=all)
  endif()
  if(VOREL_LINKER_JOINS)
    target_link_options(${target} PRIVATE -Wl,-z,noseparate-code)
  endif()
  if(NOT ANDROID)
    target_link_options(${target} PRIVATE -Wl,--hash-style=gnu)
  endif()
endfunction()

# vorel_library(TARGET CHOICE LEVELS LEVEL...): makes a library of all objects, of the choice of the level,
# and of the levels to choose from.
function(vorel_library target choice)
  cmake_parse_arguments(PARSE_ARGV 2 arg "" "" "LEVELS")
  target_sources(${target} PRIVATE
    ${choice} ${PROJECT_SOURCE_DIR}/blend/loop_tables.cpp ${PROJECT_SOURCE_DIR}/ops/loop_tables.cpp
    $<TARGET_OBJECTS:voreleffect_objects> $<TARGET_OBJECTS:voreleffect_capi>)
  foreach(level IN LISTS arg_LEVELS)
    target_sources(${target} PRIVATE $<TARGET_OBJECTS:voreleffect_${level}>)
  endforeach()
  if(NOT scalar IN_LIST arg_LEVELS)
    target_compile_definitions(${target} PRIVATE VOREL_WITHOUT_SCALAR)
  elseif(arg_LEVELS STREQUAL scalar AND NOT VOREL_LEVELS STREQUAL scalar)
    target_compile_definitions(${target} PRIVATE VOREL_WITHOUT_VECTORS)
  endif()
  if(VOREL_FOR_WASM)
    # The C face throws, which the packaged library of C++ cannot.
    target_sources(${target} PRIVATE ${PROJECT_SOURCE_DIR}/bindings/js/module/exceptions.cpp)
    set_source_files_properties(${PROJECT_SOURCE_DIR}/bindings/js/module/exceptions.cpp
      TARGET_DIRECTORY ${target} PROPERTIES COMPILE_OPTIONS -fexceptions)
  endif()
  vorel_objects(${target})
  vorel_strict_link(${target})
  target_include_directories(${target} PUBLIC $<BUILD_INTERFACE:${PROJECT_SOURCE_DIR}/include>)
  target_compile_features(${target} PUBLIC cxx_std_17)
endfunction()
