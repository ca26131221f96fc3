# One object library of the inner loops for each level, from the plainest to the best: the names and
# their order are those of simd/cpu_level.h.
check_cxx_symbol_exists(__x86_64__ cstddef VOREL_FOR_X86_64)
check_cxx_symbol_exists(__aarch64__ cstddef VOREL_FOR_AARCH64)
if(VOREL_FOR_X86_64)
  set(VOREL_LEVELS scalar sse2 avx2 avx512)
elseif(VOREL_FOR_AARCH64)
  set(VOREL_LEVELS scalar neon dotprod)
elseif(VOREL_FOR_WASM)
  set(VOREL_LEVELS scalar simd128)
else()
  set(VOREL_LEVELS scalar)
endif()

# On x86-64 a level has the vectors of its name and no wider ones, whatever -march a build asks for.
set(VOREL_FLAGS_scalar -DVOREL_SCALAR)
set(VOREL_FLAGS_sse2 -mno-avx)
set(VOREL_FLAGS_avx2 -mavx2 -mno-avx512f)
set(VOREL_FLAGS_avx512 -mavx512f -mavx512bw -mavx512dq -mavx512vl -mavx512vnni)
set(VOREL_FLAGS_dotprod -march=armv8.2-a+dotprod)
set(VOREL_FLAGS_simd128 -msimd128)
set(VOREL_BYTES_scalar 4)
set(VOREL_BYTES_sse2 16)
set(VOREL_BYTES_avx2 32)
set(VOREL_BYTES_avx512 64)
set(VOREL_BYTES_neon 16)
set(VOREL_BYTES_dotprod 16)
set(VOREL_BYTES_simd128 16)

# The plainest level of vectors runs on every CPU of its kind: the scalar one is for the tests then. On
# WebAssembly it is a module of its own as well (bindings/js/module).
set(VOREL_SHIPPED_LEVELS ${VOREL_LEVELS})
if(VOREL_FOR_X86_64 OR VOREL_FOR_AARCH64 OR VOREL_FOR_WASM)
  list(REMOVE_ITEM VOREL_SHIPPED_LEVELS scalar)
endif()
if(VOREL_FOR_X86_64 OR VOREL_FOR_AARCH64)
  list(APPEND VOREL_FLAGS_scalar $<$<CONFIG:Release>:-Os>)
endif()

# What the loops gain by their vectors compilers do not add to: g++ need not copy conditions of loops before
# them, nor align jumps, and clang need not unroll these sources (docs/benchmarks.md, "Size").
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
  set(VOREL_LOOP_FLAGS -fno-tree-ch -fno-align-jumps -fno-align-labels)
else()
  set(VOREL_SMALL_LOOPS
    ops/blur/difference_loops.cpp
    ops/dilate/dilation_loops.cpp
    ops/grow/growth_loops.cpp
    ops/ramp/ramp_loops.cpp)
  if(VOREL_FOR_WASM)
    # What is fetched with a page. Natively it takes a thirtieth more time, a glyph a twelfth.
    list(APPEND VOREL_SMALL_LOOPS ops/blur/narrow_loops.cpp)
  endif()
  set_source_files_properties(${VOREL_SMALL_LOOPS}
    PROPERTIES COMPILE_OPTIONS $<$<CONFIG:Release>:-Os>)
endif()

# vorel_level_objects(TARGET LEVEL SOURCE...): objects of sources that are compiled once for each level.
function(vorel_level_objects target level)
  add_library(${target} OBJECT ${ARGN})
  vorel_objects(${target})
  target_compile_definitions(${target} PRIVATE
    VOREL_LEVEL=${level} VOREL_VECTOR_BYTES=${VOREL_BYTES_${level}})
  target_compile_options(${target} PRIVATE "$<$<CONFIG:Release>:${VOREL_LOOP_FLAGS}>")
  # Vectors are passed within a level's sources alone: their calling convention is moot.
  target_compile_options(${target} PRIVATE ${VOREL_FLAGS_${level}} -Wno-psabi)
  if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    # Its own headers leave vectors uninitialised on purpose.
    target_compile_options(${target} PRIVATE -Wno-maybe-uninitialized -Wno-uninitialized)
  endif()
endfunction()

foreach(level IN LISTS VOREL_LEVELS)
  vorel_level_objects(voreleffect_${level} ${level} ${VOREL_DOT_SOURCES})
  if(NOT level STREQUAL dotprod)
    target_sources(voreleffect_${level} PRIVATE ${VOREL_LEVEL_SOURCES})
  endif()
endforeach()
