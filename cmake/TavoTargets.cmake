# Helpers shared by every target of the project.

# Warnings on and kept at zero; CI builds with TAVO_WARNINGS_AS_ERRORS.
# -Wnon-virtual-dtor stays off: the surfaces' virtual tables are a fixed
# layout that a virtual destructor would change, and the core's surface base
# keeps its destructor protected instead, so no surface is deleted through it.
function(tavo_warnings target)
  target_compile_options(${target} PRIVATE -Wall -Wextra -Woverloaded-virtual -Wshadow -Wold-style-cast)
  if(TAVO_WARNINGS_AS_ERRORS)
    target_compile_options(${target} PRIVATE -Werror)
  endif()
endfunction()

# tavo_test(<name> SOURCES <files...> [LIBRARIES <targets...>])
# One executable of GoogleTest cases, registered as one ctest test so that the
# suite starts few Wine processes.
function(tavo_test name)
  cmake_parse_arguments(ARG "" "" "SOURCES;LIBRARIES" ${ARGN})
  add_executable(${name} ${ARG_SOURCES})
  tavo_warnings(${name})
  target_link_libraries(${name} PRIVATE ${ARG_LIBRARIES} GTest::gtest_main)
  add_test(NAME ${name} COMMAND ${name} --gtest_color=no)
  # The Wine runner needs these to start the keeper and register the printer.
  add_dependencies(${name} wine_keeper wine_printer_setup)
endfunction()
