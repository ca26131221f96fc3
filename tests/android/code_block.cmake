# vorel_code_block(PAGE LANGUAGE FILE): writes the first block of code in that language of a Markdown page
# to a file, anew whenever the page changes.
function(vorel_code_block page language file)
  cmake_path(ABSOLUTE_PATH page)
  find_package(Python3 REQUIRED COMPONENTS Interpreter)
  add_custom_command(
    OUTPUT ${file}
    COMMAND ${Python3_EXECUTABLE} ${CMAKE_CURRENT_FUNCTION_LIST_DIR}/code_block.py ${page} ${language} ${file}
    DEPENDS ${page} ${CMAKE_CURRENT_FUNCTION_LIST_DIR}/code_block.py
    VERBATIM)
endfunction()
