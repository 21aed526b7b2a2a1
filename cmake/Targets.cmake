# One object library per module of the platform, so that a module can be built and tested alone; one test executable per
# folder of tests.

# tarnell_precompile(TARGET header...)
function(tarnell_precompile name)
  target_precompile_headers(${name} PRIVATE ${ARGN})
  if(CMAKE_CXX_COMPILER_ID MATCHES "Clang")
    # For ccache, a header that was rewritten with the same text is unchanged.
    target_compile_options(${name} PRIVATE "SHELL:-Xclang -fno-pch-timestamp")
  endif()
endfunction()

# Sources with a name that another source of their folder uses for something else; and what only the tool has.
set(tarnell_compiled_alone
  animation/FrameRateOfTimes cache/PointCache2 container/BinaryReader core/FbxTime document/ValueCounts
  faithful/CameraReading faithful/PlacementWriting faithful/Shear geometry/LayerWriting model/TnFbxLight model/TnFbxMarker
  legacy/TakeWriting
  sdk/PropertySampling tarnell-fbx/main)

# Builds with sanitizers or counters read what most sources include only once, and compile several sources as one: that
# takes less than half of the time. The others do without: they show whether each source includes what it uses.
function(tarnell_share_headers name)
  if(TARNELL_FBX_SANITIZE OR TARNELL_FBX_COVERAGE OR TARNELL_FBX_COUNT_STEPS)
    tarnell_precompile(${name}
      <algorithm> <functional> <memory> <span> <string> <string_view> <unordered_map> <vector>)
    set_target_properties(${name} PROPERTIES UNITY_BUILD ON UNITY_BUILD_BATCH_SIZE 10)
    get_target_property(sources ${name} SOURCES)
    string(REPLACE ";" "|" alone "${tarnell_compiled_alone}")
    list(FILTER sources INCLUDE REGEX "(${alone})[.]cpp$")
    set_source_files_properties(${sources} PROPERTIES SKIP_UNITY_BUILD_INCLUSION ON)
  endif()
endfunction()

# Lets every basic block of the target call a function, by which tests/growth counts work. In other programs the function
# does nothing.
if(TARNELL_FBX_COUNT_STEPS)
  set(source "${CMAKE_CURRENT_BINARY_DIR}/uncounted_steps.cpp")
  file(CONFIGURE OUTPUT "${source}" CONTENT "extern \"C\" __attribute__((visibility(\"hidden\"))) void __sanitizer_cov_trace_pc() {}\n")
  add_library(tarnell_uncounted_steps STATIC "${source}")
  set_target_properties(tarnell_uncounted_steps PROPERTIES POSITION_INDEPENDENT_CODE ON)
  target_link_libraries(tarnell_settings INTERFACE tarnell_uncounted_steps)
endif()
function(tarnell_count_steps name)
  if(TARNELL_FBX_COUNT_STEPS)
    target_compile_options(${name} PRIVATE -fsanitize-coverage=trace-pc)
  endif()
endfunction()

# A shared library exports what cmake/NAME.map lists.
function(tarnell_export name)
  set(map "${PROJECT_SOURCE_DIR}/cmake/${name}.map")
  target_link_options(${name} PRIVATE "LINKER:--version-script=${map}")
  set_target_properties(${name} PROPERTIES LINK_DEPENDS "${map}")
endfunction()

# tarnell_module(NAME [NEEDS module...] [LIBRARIES library...]): every source below src/NAME. A module may use those it
# needs, and those that these need. `fbxsdk_up_to_NAME` is all of them, with the internals visible: what the module's
# tests link.
function(tarnell_module name)
  cmake_parse_arguments(ARG "" "" "NEEDS;LIBRARIES" ${ARGN})
  file(GLOB_RECURSE sources CONFIGURE_DEPENDS "${CMAKE_CURRENT_SOURCE_DIR}/src/${name}/*.cpp")
  add_library(fbxsdk_${name} OBJECT ${sources})
  target_link_libraries(fbxsdk_${name} PUBLIC tarnell_settings ${ARG_LIBRARIES})
  target_include_directories(fbxsdk_${name} PUBLIC
    "${PROJECT_SOURCE_DIR}/fbxsdk/include" "${PROJECT_SOURCE_DIR}/fbxsdk/src")
  target_compile_definitions(fbxsdk_${name} PRIVATE FBXSDK_BUILDING)
  tarnell_share_headers(fbxsdk_${name})
  tarnell_count_steps(fbxsdk_${name})

  set(modules ${name})
  foreach(need IN LISTS ARG_NEEDS)
    get_property(below GLOBAL PROPERTY fbxsdk_up_to_${need})
    list(APPEND modules ${below})
  endforeach()
  list(REMOVE_DUPLICATES modules)
  set_property(GLOBAL PROPERTY fbxsdk_up_to_${name} ${modules})
  add_library(fbxsdk_up_to_${name} INTERFACE)
  foreach(module IN LISTS modules)
    target_link_libraries(fbxsdk_up_to_${name} INTERFACE fbxsdk_${module} $<TARGET_OBJECTS:fbxsdk_${module}>)
  endforeach()
  set_property(GLOBAL APPEND PROPERTY fbxsdk_modules ${name})
endfunction()

# To read GoogleTest takes longer than to compile most tests: an empty program reads it for all.
function(tarnell_precompile_test_headers name)
  if(NOT TARGET test_headers)
    set(empty "${CMAKE_CURRENT_BINARY_DIR}/test_headers.cpp")
    file(CONFIGURE OUTPUT "${empty}" CONTENT "")
    add_executable(test_headers "${empty}")
    target_link_libraries(test_headers PRIVATE tarnell_settings GTest::gtest GTest::gmock GTest::gtest_main)
    target_compile_options(test_headers PRIVATE -O0)
    tarnell_precompile(test_headers <gmock/gmock.h> <gtest/gtest.h>)
  endif()
  target_precompile_headers(${name} REUSE_FROM test_headers)
endfunction()

# tarnell_test(NAME FOLDER folder [DEEP] LINK target...): every *Test.cpp of the folder becomes one executable;
# with DEEP those of its subfolders, too.
# tarnell_test(NAME SOURCES file... LINK target...): these files do.
function(tarnell_test name)
  cmake_parse_arguments(ARG "DEEP" "FOLDER" "LINK;SOURCES" ${ARGN})
  set(sources ${ARG_SOURCES})
  if(ARG_FOLDER)
    set(glob GLOB)
    if(ARG_DEEP)
      set(glob GLOB_RECURSE)
    endif()
    file(${glob} sources CONFIGURE_DEPENDS "${CMAKE_CURRENT_SOURCE_DIR}/${ARG_FOLDER}/*Test.cpp")
  endif()
  if(NOT sources)
    return()
  endif()
  add_executable(${name} ${sources})
  target_include_directories(${name} PRIVATE "${CMAKE_CURRENT_SOURCE_DIR}")
  target_compile_definitions(${name} PRIVATE TARNELL_TEST_DATA="${PROJECT_SOURCE_DIR}/tests/data")
  target_link_libraries(${name} PRIVATE ${ARG_LINK} tarnell_settings GTest::gtest GTest::gmock GTest::gtest_main)
  # They run for moments: to optimise them takes longer than it saves.
  target_compile_options(${name} PRIVATE -O0)
  tarnell_precompile_test_headers(${name})
  if(TARNELL_FBX_SANITIZE OR TARNELL_FBX_COVERAGE)
    # To start an instrumented program takes longer than most of its tests.
    add_test(NAME ${name} COMMAND ${name} --gtest_brief=1)
    set_tests_properties(${name} PROPERTIES TIMEOUT 900)
  else()
    gtest_discover_tests(${name} TEST_PREFIX "${name}." DISCOVERY_TIMEOUT 60 PROPERTIES TIMEOUT 600)
  endif()
endfunction()
