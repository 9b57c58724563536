# Settings shared by every target of the project (not by third-party code).
function(vek_target_defaults target)
  # Every narrow literal is a code page 932 string: the game reads the same
  # bytes. (Not for GoogleTest's own sources: its <chrono> has literals that
  # code page has no form for.)
  target_compile_options(${target} PRIVATE -finput-charset=UTF-8 -fexec-charset=CP932 -Wall -Wextra)
  if(VEK_WARNINGS_AS_ERRORS)
    target_compile_options(${target} PRIVATE -Werror)
  endif()
  target_include_directories(${target} PUBLIC ${PROJECT_SOURCE_DIR})
endfunction()

# A portable library: on Windows it takes its *_win32.cpp files, elsewhere its
# *_posix.cpp files, and everything else on both.
function(vek_library name)
  cmake_parse_arguments(ARG "" "" "SOURCES;WIN32_SOURCES;POSIX_SOURCES;LIBS" ${ARGN})
  set(sources ${ARG_SOURCES})
  if(WIN32)
    list(APPEND sources ${ARG_WIN32_SOURCES})
  else()
    list(APPEND sources ${ARG_POSIX_SOURCES})
  endif()
  add_library(${name} STATIC ${sources})
  vek_target_defaults(${name})
  target_link_libraries(${name} PUBLIC ${ARG_LIBS})
endfunction()

# One test executable is one ctest test: under Wine each process start counts.
function(vek_test name)
  cmake_parse_arguments(ARG "" "" "SOURCES;LIBS" ${ARGN})
  add_executable(${name} ${ARG_SOURCES})
  vek_target_defaults(${name})
  target_link_libraries(${name} PRIVATE ${ARG_LIBS} vek_gtest_main)
  add_test(NAME ${name} COMMAND ${name})
endfunction()
