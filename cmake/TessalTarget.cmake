# How every target of the project is compiled, in one place.

add_library(tessal_options INTERFACE)
target_include_directories(tessal_options INTERFACE "${CMAKE_SOURCE_DIR}/src")
target_compile_options(tessal_options INTERFACE
  -Wall -Wextra -Wpedantic -Wshadow -Wconversion -Wnon-virtual-dtor -Woverloaded-virtual -Werror
  # What a library shows, it says so.
  -fvisibility=hidden -fvisibility-inlines-hidden)

if(TESSAL_SANITIZERS)
  target_compile_options(tessal_options INTERFACE
    -fsanitize=${TESSAL_SANITIZERS} -fno-sanitize-recover=all -fno-omit-frame-pointer)
  target_link_options(tessal_options INTERFACE -fsanitize=${TESSAL_SANITIZERS})
  if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU")
    # GCC takes the sanitizers' own bookkeeping for reads of uninitialized values.
    target_compile_options(tessal_options INTERFACE -Wno-maybe-uninitialized)
  endif()
endif()

if(TESSAL_COVERAGE)
  target_compile_options(tessal_options INTERFACE --coverage)
  target_link_options(tessal_options INTERFACE --coverage)
endif()

if(TESSAL_FUZZERS)
  # Coverage feedback everywhere, the fuzzer's main only where a target asks for it.
  target_compile_options(tessal_options INTERFACE -fsanitize=fuzzer-no-link)
endif()

# tessal_library(NAME SOURCES... LIBRARIES...)
# A static library of one folder. LIBRARIES are the floors below that its headers or sources use.
function(tessal_library name)
  cmake_parse_arguments(ARG "" "" "SOURCES;LIBRARIES" ${ARGN})
  add_library(${name} STATIC ${ARG_SOURCES})
  target_link_libraries(${name} PUBLIC tessal_options ${ARG_LIBRARIES})
endfunction()

# tessal_grammar(HEADER_VARIABLE HEADER)
# The automaton of the folder's grammar.y as tables: a header, by our own skeleton.
function(tessal_grammar header_variable header)
  set(file "${CMAKE_CURRENT_BINARY_DIR}/generated/${header}")
  cmake_path(GET file PARENT_PATH folder)
  file(MAKE_DIRECTORY "${folder}")
  add_custom_command(OUTPUT "${file}"
    COMMAND ${BISON_EXECUTABLE} -Wno-yacc -o "${file}" grammar.y
    DEPENDS grammar.y "${CMAKE_SOURCE_DIR}/src/platform/lalr_tables.m4"
    WORKING_DIRECTORY "${CMAKE_CURRENT_SOURCE_DIR}" VERBATIM)
  set(${header_variable} "${file}" PARENT_SCOPE)
endfunction()

# tessal_test(NAME SOURCES... LIBRARIES...)
# A GoogleTest program whose cases CTest knows one by one.
function(tessal_test name)
  cmake_parse_arguments(ARG "" "" "SOURCES;LIBRARIES" ${ARGN})
  add_executable(${name} ${ARG_SOURCES})
  target_include_directories(${name} PRIVATE "${CMAKE_SOURCE_DIR}/tests")
  target_compile_definitions(${name} PRIVATE TESSAL_SOURCE_DIR="${CMAKE_SOURCE_DIR}")
  target_link_libraries(${name} PRIVATE tessal_options ${ARG_LIBRARIES} GTest::gtest GTest::gtest_main)
  gtest_discover_tests(${name} DISCOVERY_TIMEOUT 60 PROPERTIES TIMEOUT 300)
endfunction()

# tessal_benchmark(NAME SOURCES... LIBRARIES...)
# A program of benchmarks with the common main; one that has its own is an executable as any other.
function(tessal_benchmark name)
  cmake_parse_arguments(ARG "" "" "SOURCES;LIBRARIES" ${ARGN})
  add_executable(${name} ${ARG_SOURCES})
  target_link_libraries(${name} PRIVATE tessal_options ${ARG_LIBRARIES} benchmark::benchmark tessal_bench_main)
endfunction()

# tessal_fuzzer(NAME SOURCES... LIBRARIES...)
function(tessal_fuzzer name)
  cmake_parse_arguments(ARG "" "" "SOURCES;LIBRARIES" ${ARGN})
  add_executable(${name} ${ARG_SOURCES})
  target_link_libraries(${name} PRIVATE tessal_options ${ARG_LIBRARIES})
  target_link_options(${name} PRIVATE -fsanitize=fuzzer)
endfunction()
