# The warnings that every target of the project is built with.
function(vorel_warnings target)
  target_compile_options(${target} PRIVATE -Wall -Wextra -Wconversion -Wshadow)
  if(VOREL_WERROR)
    target_compile_options(${target} PRIVATE -Werror)
  endif()
endfunction()
