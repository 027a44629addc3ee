# Warnings and strictness that all of our own code shares.
add_library(tessarine_options INTERFACE)
target_compile_options(tessarine_options INTERFACE
  -Wall -Wextra -Wpedantic -Werror -Wshadow -Wconversion -Wno-sign-conversion -Wnon-virtual-dtor
  -Woverloaded-virtual -Wold-style-cast -Wcast-align -Wnull-dereference -Wformat=2
  -fno-math-errno)  # nobody looks at it, and rounding becomes one instruction
target_compile_definitions(tessarine_options INTERFACE
  QT_NO_CAST_FROM_ASCII QT_NO_CAST_TO_ASCII QT_NO_URL_CAST_FROM_STRING QT_NO_NARROWING_CONVERSIONS_IN_CONNECT
  QT_NO_FOREACH QT_USE_QSTRINGBUILDER)
if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
  # gcc 12 reports faults inside the standard library's own code when it inlines strings and vectors.
  target_compile_options(tessarine_options INTERFACE
    -Wno-null-dereference -Wno-restrict -Wno-array-bounds -Wno-stringop-overflow -Wno-stringop-overread)
endif()
if(TESSARINE_SANITIZE)
  target_compile_options(tessarine_options INTERFACE
    -fsanitize=address,undefined,fuzzer-no-link -fno-sanitize-recover=undefined -fno-omit-frame-pointer)
  target_link_options(tessarine_options INTERFACE -fsanitize=address,undefined,fuzzer-no-link)
endif()

# What the program is made of: the same, with src/ as include root.
add_library(tessarine_source INTERFACE)
target_link_libraries(tessarine_source INTERFACE tessarine_options)
target_include_directories(tessarine_source INTERFACE ${CMAKE_SOURCE_DIR}/src)

# tessarine_unite(<target> <kind>): compiles several of the target's sources as one, which takes half the time, where
# TESSARINE_UNITE asks for targets of this kind: "tests" or "product".
function(tessarine_unite target kind)
  if(NOT TESSARINE_UNITE MATCHES "^(all|${kind})$")
    return()
  endif()
  get_target_property(sources ${target} SOURCES)
  list(FILTER sources INCLUDE REGEX "\\.cpp$")
  execute_process(
    COMMAND awk -v most=8 -f ${CMAKE_SOURCE_DIR}/tools/source_names.awk -f ${CMAKE_SOURCE_DIR}/cmake/unite.awk ${sources}
    WORKING_DIRECTORY ${CMAKE_CURRENT_SOURCE_DIR} COMMAND_ERROR_IS_FATAL ANY OUTPUT_VARIABLE groups)
  string(REGEX MATCHALL "[^\n]+" groups "${groups}")
  foreach(line IN LISTS groups)
    string(REGEX MATCH "^([0-9]+) (.*)$" line "${line}")
    set_source_files_properties(${CMAKE_MATCH_2} PROPERTIES UNITY_GROUP ${CMAKE_MATCH_1})
  endforeach()
  set_target_properties(${target} PROPERTIES UNITY_BUILD ON UNITY_BUILD_MODE GROUP)
endfunction()

# tessarine_library(<name> <sources>...): one folder's library of the program.
function(tessarine_library name)
  add_library(${name} STATIC ${ARGN})
  target_link_libraries(${name} PUBLIC tessarine_source)
  tessarine_unite(${name} product)
endfunction()

# tessarine_precompile(<target> <kind> <header>...): the first target of a kind precompiles the headers, and the others of
# that kind use the result, so all of them need the same compiler options.
function(tessarine_precompile target kind)
  get_property(owner GLOBAL PROPERTY TESSARINE_HEADERS_OF_${kind})
  if(owner)
    target_precompile_headers(${target} REUSE_FROM ${owner})
  else()
    target_precompile_headers(${target} PRIVATE ${ARGN})
    set_property(GLOBAL PROPERTY TESSARINE_HEADERS_OF_${kind} ${target})
  endif()
endfunction()

# tessarine_windows(<name> <sources>...): the windows of one folder, with their forms. Qt's headers are precompiled: reading
# them would take most of the build.
function(tessarine_windows name)
  tessarine_library(${name} ${ARGN})
  # The forms are sources too: otherwise the build does not know that the headers made of them are generated, and after a
  # change of a form alone only the next run would compile what includes its header.
  foreach(source IN LISTS ARGN)
    cmake_path(REPLACE_EXTENSION source ui OUTPUT_VARIABLE form)
    if(EXISTS ${CMAKE_CURRENT_SOURCE_DIR}/${form})
      target_sources(${name} PRIVATE ${form})
    endif()
  endforeach()
  target_link_libraries(${name} PUBLIC Qt6::Widgets)
  set_target_properties(${name} PROPERTIES AUTOMOC ON AUTOUIC ON AUTORCC ON)
  tessarine_precompile(${name} windows <QtWidgets>)
endfunction()

# tessarine_test_label(<label>): fails unless it is one of the four kinds of tests.
#   logic   no window, no line, no other program: together a matter of seconds
#   window  windows, offscreen, with mouse and key events
#   wire    over pseudo terminals: the real serial part, the simulated venue
#   real    real parts of the platform: files, databases, old installations, the word processor
function(tessarine_test_label label)
  if(NOT label MATCHES "^(logic|window|wire|real)$")
    message(FATAL_ERROR "Tests are logic, window, wire or real, not \"${label}\"")
  endif()
endfunction()

# tessarine_test(<name> [LABEL <label>] LIBS <libs>... SOURCES <sources>...): a GoogleTest program whose tests ctest knows
# one by one: a process for each costs 8 ms, and a thousand of them are still seconds. With sanitizers it costs up to 0.2 s,
# so there the program is one test, and also without windows, where the same tests run once more. Without a label those with
# the main program of window tests are window tests, and all others logic.
function(tessarine_test name)
  cmake_parse_arguments(ARG "" "LABEL" "LIBS;SOURCES" ${ARGN})
  if(NOT ARG_LABEL AND "tessarine_test_windows" IN_LIST ARG_LIBS)
    set(ARG_LABEL window)
  elseif(NOT ARG_LABEL)
    set(ARG_LABEL logic)
  endif()
  tessarine_test_label(${ARG_LABEL})
  add_executable(${name} ${ARG_SOURCES})
  tessarine_unite(${name} tests)
  target_link_libraries(${name} PRIVATE ${ARG_LIBS} tessarine_options GTest::gmock GTest::gtest_main)
  target_include_directories(${name} PRIVATE ${CMAKE_SOURCE_DIR} ${CMAKE_SOURCE_DIR}/src)
  # A test's own code runs only once: building it in half the time is worth more than its speed. Qt requires -fPIC.
  target_compile_options(${name} PRIVATE -O0 -fPIC)
  if(TESSARINE_SANITIZE)
    # For the same reason only memory is watched in a test's own code.
    target_compile_options(${name} PRIVATE -fno-sanitize=undefined,fuzzer-no-link)
  endif()
  if("tessarine_test_windows" IN_LIST ARG_LIBS)
    # Qt defines these differently in each folder and its headers use them, so precompiled ones could not be shared.
    target_compile_options(${name} PRIVATE -UQT_TESTCASE_BUILDDIR -UQT_TESTCASE_SOURCEDIR)
    tessarine_precompile(${name} window_tests <gmock/gmock.h> <gtest/gtest.h> <QtTest> <QtWidgets>)
  else()
    tessarine_precompile(${name} tests <gmock/gmock.h> <gtest/gtest.h>)
  endif()
  set(environment "QT_QPA_PLATFORM=offscreen;LC_ALL=C.UTF-8")
  if(TESSARINE_SANITIZE OR NOT TESSARINE_UI)
    add_test(NAME ${name} COMMAND ${name} --gtest_brief=1)
    set_tests_properties(${name} PROPERTIES TIMEOUT 900 LABELS ${ARG_LABEL} ENVIRONMENT "${environment}")
  else()
    include(GoogleTest)
    gtest_discover_tests(${name} DISCOVERY_TIMEOUT 60 PROPERTIES TIMEOUT 300 LABELS ${ARG_LABEL} ENVIRONMENT "${environment}")
  endif()
endfunction()
