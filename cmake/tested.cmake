# The library with a level that the tests and benchmarks set (tests/support/levels.h).
add_library(voreleffect_tested)
target_sources(voreleffect_tested PRIVATE ${PROJECT_SOURCE_DIR}/tests/support/plans.cpp)
vorel_library(voreleffect_tested ${PROJECT_SOURCE_DIR}/tests/support/levels.cpp LEVELS ${VOREL_LEVELS})
vorel_library_kind(voreleffect_tested)
