# The library with a level that the tests and benchmarks set (tests/support/levels.h).
add_library(voreleffect_tested)
target_sources(voreleffect_tested PRIVATE ${PROJECT_SOURCE_DIR}/tests/support/plans.cpp)
vorel_library(voreleffect_tested ${PROJECT_SOURCE_DIR}/tests/support/levels.cpp LEVELS ${VOREL_LEVELS})
vorel_library_kind(voreleffect_tested)
# Each level's operations beside loops over their lanes.
foreach(level IN LISTS VOREL_LEVELS)
  vorel_level_objects(voreleffect_lanes_${level} ${level} ${PROJECT_SOURCE_DIR}/tests/support/lanes_check.cpp)
  target_sources(voreleffect_tested PRIVATE $<TARGET_OBJECTS:voreleffect_lanes_${level}>)
endforeach()

# The literal forms of what the library does, which tests compare with and benchmarks stand beside: -O3
# and the plain target where anything is optimised.
add_library(voreleffect_literal STATIC
  ${PROJECT_SOURCE_DIR}/tests/support/literal_blend.cpp
  ${PROJECT_SOURCE_DIR}/tests/support/literal_cores.cpp
  ${PROJECT_SOURCE_DIR}/tests/support/literal_engine.cpp)
target_include_directories(voreleffect_literal PRIVATE ${PROJECT_SOURCE_DIR})
target_compile_features(voreleffect_literal PRIVATE cxx_std_17)
target_compile_options(voreleffect_literal PRIVATE
  $<$<CONFIG:Release,RelWithDebInfo>:-O3> -ffp-contract=off -fno-fast-math)
vorel_warnings(voreleffect_literal)
