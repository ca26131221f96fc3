# One object library of the inner loops for each level, from the plainest to the best: the names and
# their order are those of core/cpu_level.h.
check_cxx_symbol_exists(__x86_64__ cstddef VOREL_FOR_X86_64)
check_cxx_symbol_exists(__aarch64__ cstddef VOREL_FOR_AARCH64)
if(VOREL_FOR_X86_64)
  set(VOREL_LEVELS scalar sse2 avx2 avx512)
elseif(VOREL_FOR_AARCH64)
  set(VOREL_LEVELS scalar neon dotprod)
else()
  set(VOREL_LEVELS scalar)
endif()

# What no processor of today runs may be slow, but not large.
set(VOREL_FLAGS_scalar -DVOREL_SCALAR $<$<CONFIG:Release>:-Os>)
set(VOREL_FLAGS_avx2 -mavx2)
set(VOREL_FLAGS_avx512 -mavx512f -mavx512bw -mavx512dq -mavx512vl -mavx512vnni)
set(VOREL_FLAGS_dotprod -march=armv8.2-a+dotprod)

# The plainest level of vectors runs on every CPU of its kind: the scalar one is for the tests then.
set(VOREL_SHIPPED_LEVELS ${VOREL_LEVELS})
if(VOREL_FOR_X86_64 OR VOREL_FOR_AARCH64)
  list(REMOVE_ITEM VOREL_SHIPPED_LEVELS scalar)
endif()

foreach(level IN LISTS VOREL_LEVELS)
  add_library(voreleffect_${level} OBJECT ${VOREL_DOT_SOURCES})
  if(NOT level STREQUAL dotprod)
    target_sources(voreleffect_${level} PRIVATE ${VOREL_LEVEL_SOURCES})
  endif()
  vorel_objects(voreleffect_${level})
  target_compile_definitions(voreleffect_${level} PRIVATE VOREL_LEVEL=${level})
  # Vectors are passed between functions that are always inlined; their calling convention is moot.
  target_compile_options(voreleffect_${level} PRIVATE ${VOREL_FLAGS_${level}} -Wno-psabi)
  if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    # Its own headers leave vectors uninitialised on purpose.
    target_compile_options(voreleffect_${level} PRIVATE -Wno-maybe-uninitialized -Wno-uninitialized)
  endif()
endforeach()
