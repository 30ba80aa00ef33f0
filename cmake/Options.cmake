# Warnings and instrumentation, attached through one interface target so that every module
# gets the same set and no directory-wide flags are needed.
option(ORVO_TESTS "Build tests, fuzzers' replays and benchmarks" ON)
option(ORVO_WERROR "Treat warnings as errors" OFF)
option(ORVO_FUZZERS "Build libFuzzer targets (clang only)" OFF)
option(ORVO_BENCHMARKS "Build the benchmarks with all else" OFF)
option(ORVO_COVERAGE "Instrument for coverage" OFF)
set(ORVO_SANITIZE "" CACHE STRING "Value for -fsanitize=, e.g. address,undefined")

set(ORVO_TEST_FEEDS "${PROJECT_SOURCE_DIR}/../shared/data" CACHE PATH "Captured feeds for tests (skipped when absent)")

if(CMAKE_CXX_COMPILER_ID STREQUAL "GNU" AND NOT ORVO_FUZZERS)
  find_program(MOLD mold)
  if(MOLD)
    add_link_options(-fuse-ld=mold)
  endif()
endif()

# Each library that is loaded costs every start its relocations: only those that a program calls.
add_link_options(LINKER:--as-needed)

set(CMAKE_CXX_STANDARD 20)
set(CMAKE_CXX_STANDARD_REQUIRED ON)
set(CMAKE_CXX_EXTENSIONS OFF)
set(CMAKE_CXX_VISIBILITY_PRESET hidden)

add_library(project_warnings INTERFACE)
target_compile_options(project_warnings INTERFACE
  -Wall -Wextra -Wno-missing-field-initializers # a designated initialiser names what it sets; the rest has its default
  -Wpedantic -Wshadow -Wconversion -Wsign-conversion -Wold-style-cast
  -Wnon-virtual-dtor -Woverloaded-virtual -Wcast-align -Wundef -Wformat=2 -Wimplicit-fallthrough
  $<$<CXX_COMPILER_ID:GNU>:-Wduplicated-cond -Wduplicated-branches -Wlogical-op -Wsuggest-override>
  $<$<CXX_COMPILER_ID:Clang>:-Wdocumentation -Wextra-semi -Wunreachable-code>
  # In a unity build every source counts as a header, in which what a source keeps to itself would be shared.
  $<$<AND:$<BOOL:${CMAKE_UNITY_BUILD}>,$<CXX_COMPILER_ID:GNU>>:-Wno-subobject-linkage>
  # GCC 12 sees it wherever an optimised build moves an empty std::optional of a number.
  $<$<AND:$<CXX_COMPILER_ID:GNU>,$<NOT:$<CONFIG:Debug>>>:-Wno-maybe-uninitialized>
  $<$<BOOL:${ORVO_WERROR}>:-Werror>)

if(ORVO_SANITIZE)
  add_compile_options(-fsanitize=${ORVO_SANITIZE} -fno-omit-frame-pointer -fno-sanitize-recover=all)
  add_link_options(-fsanitize=${ORVO_SANITIZE})
endif()
if(ORVO_FUZZERS)
  add_compile_options(-fsanitize=fuzzer-no-link)  # coverage feedback from the libraries too
endif()
if(ORVO_COVERAGE)
  add_compile_options(--coverage)
  add_link_options(--coverage)
endif()

# add_fuzzer(Fuzz<Name> LIBS ...): with clang and ORVO_FUZZERS a libFuzzer binary; otherwise a
# plain program that replays files, so corpora run as ordinary regression tests under any compiler.
function(add_fuzzer name)
  cmake_parse_arguments(PARSE_ARGV 1 arg "" "" "LIBS")
  add_executable(${name} ${name}.cpp)
  target_link_libraries(${name} PRIVATE ${arg_LIBS} project_warnings)
  if(ORVO_FUZZERS)
    target_compile_options(${name} PRIVATE -fsanitize=fuzzer)
    target_link_options(${name} PRIVATE -fsanitize=fuzzer)
    set(replay ${name} -runs=0)
  else()
    target_sources(${name} PRIVATE ReplayMain.cpp)
    set(replay ${name})
  endif()
  file(GLOB corpus CONFIGURE_DEPENDS corpus/${name}/*)
  if(corpus)
    add_test(NAME fuzz.${name} COMMAND ${replay} ${corpus})
  endif()
endfunction()
