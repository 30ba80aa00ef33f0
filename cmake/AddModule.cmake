# add_module(<folder> [THIRD_PARTY <targets>])
#
# One static library per folder under src/: every .h and .cpp that lies directly in it. What it may include and link is its row
# in ModuleMap.cmake. Its headers are a header set, so that each is compiled on its own by
# all_verify_interface_header_sets; third-party libraries are always PRIVATE, so a public header that mentions one fails there.
include_guard(GLOBAL)
include(${CMAKE_CURRENT_LIST_DIR}/ModuleMap.cmake)

function(_allowed_dependencies module out)
  foreach(row IN LISTS MODULE_MAP)
    if(row MATCHES "^${module}:(.*)$")
      separate_arguments(deps UNIX_COMMAND "${CMAKE_MATCH_1}")
      set(${out} "${deps}" PARENT_SCOPE)
      return()
    endif()
  endforeach()
  message(FATAL_ERROR "Module '${module}' has no row in cmake/ModuleMap.cmake")
endfunction()

function(_module_target module out)
  string(REPLACE "/" "_" target "${module}")
  set(${out} "orvo_${target}" PARENT_SCOPE)
endfunction()

function(add_module module)
  cmake_parse_arguments(PARSE_ARGV 1 arg "" "" "THIRD_PARTY")
  _allowed_dependencies(${module} allowed)
  _module_target(${module} target)
  set(folder ${PROJECT_SOURCE_DIR}/src/${module})
  file(GLOB headers CONFIGURE_DEPENDS ${folder}/*.h)
  file(GLOB sources CONFIGURE_DEPENDS ${folder}/*.cpp)
  if(NOT sources AND NOT headers)
    return()
  endif()
  add_library(${target} STATIC ${sources} ${headers})
  set_target_properties(${target} PROPERTIES LINKER_LANGUAGE CXX)
  foreach(dep IN LISTS allowed)
    _module_target(${dep} dep_target)
    if(TARGET ${dep_target})
      target_link_libraries(${target} PUBLIC ${dep_target})
    endif()
  endforeach()
  target_sources(${target} PUBLIC FILE_SET HEADERS BASE_DIRS ${PROJECT_SOURCE_DIR}/src FILES ${headers})
  target_link_libraries(${target} PRIVATE ${arg_THIRD_PARTY} project_warnings)
  if(arg_THIRD_PARTY MATCHES "Qt6::")
    # Its words for signals and slots would be macros in every source that follows in a unity build.
    target_compile_definitions(${target} PRIVATE QT_NO_KEYWORDS)
  endif()
  set_target_properties(${target} PROPERTIES VERIFY_INTERFACE_HEADER_SETS ON)
endfunction()

# add_module_tests(<folder> [LIBS …]): one executable for the tests of one folder: every .cpp that lies directly in tests/<folder>.
# Their environment is fixed by tests/support/TestMain.cpp.
function(add_module_tests module)
  cmake_parse_arguments(PARSE_ARGV 1 arg "" "" "LIBS")
  _module_target(${module} target)
  file(GLOB sources CONFIGURE_DEPENDS ${PROJECT_SOURCE_DIR}/tests/${module}/*.cpp)
  if(NOT sources OR NOT TARGET ${target})
    return()
  endif()
  add_executable(${target}_test ${sources})
  set_target_properties(${target}_test PROPERTIES UNITY_BUILD OFF) # each file keeps its helpers to itself
  target_link_libraries(${target}_test PRIVATE ${target} orvo_test_support ${arg_LIBS} project_warnings)
  target_include_directories(${target}_test PRIVATE ${PROJECT_SOURCE_DIR}/tests)
  target_compile_definitions(${target}_test PRIVATE
    ORVO_TEST_SOURCE_DIR="${PROJECT_SOURCE_DIR}/tests" ORVO_TEST_RESOURCES="${PROJECT_SOURCE_DIR}/resources")
  gtest_discover_tests(${target}_test DISCOVERY_MODE PRE_TEST PROPERTIES LABELS ${module} TIMEOUT 120)
endfunction()
