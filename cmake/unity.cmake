# Many sources as one: most of what a small source costs is the headers that all of them include. Not for the
# library, whose sources are compiled as they are shipped.
option(VOREL_UNITY "Compile the sources of the tools and of the tests many at a time" OFF)

# vorel_unity(TARGET [APART SOURCE...]): those that stand apart have names of their own that others have too.
function(vorel_unity target)
  cmake_parse_arguments(PARSE_ARGV 1 arg "" "" "APART")
  set_target_properties(${target} PROPERTIES UNITY_BUILD ${VOREL_UNITY} UNITY_BUILD_BATCH_SIZE 16)
  set_source_files_properties(${arg_APART} PROPERTIES SKIP_UNITY_BUILD_INCLUSION ON)
endfunction()
