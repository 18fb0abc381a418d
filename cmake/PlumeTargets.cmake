# How every target of Plume is built: warnings are errors where PLUME_WERROR is on, sanitizers come from PLUME_SANITIZE.

add_library(plume_options INTERFACE)
target_compile_options(plume_options INTERFACE
  -Wall -Wextra -Wpedantic -Wshadow -Wconversion -Wsign-conversion -Wnon-virtual-dtor -Woverloaded-virtual
  -Wimplicit-fallthrough $<$<BOOL:${PLUME_WERROR}>:-Werror>
  # GCC 12 raises false alarms when it optimises: overlapping copies in plain string concatenation (its bug 105651), and
  # unset members in variants that hold strings. Clang's builds and the sanitizers keep watch over both.
  $<$<CXX_COMPILER_ID:GNU>:-Wno-restrict> $<$<CXX_COMPILER_ID:GNU>:-Wno-maybe-uninitialized>
  # GCC takes a source that is compiled together with others for a header of theirs.
  $<$<AND:$<CXX_COMPILER_ID:GNU>,$<BOOL:${CMAKE_UNITY_BUILD}>>:-Wno-subobject-linkage>)
if(PLUME_SANITIZE)
  target_compile_options(plume_options INTERFACE
    -fsanitize=${PLUME_SANITIZE} -fno-sanitize-recover=all -fno-omit-frame-pointer)
  target_link_options(plume_options INTERFACE -fsanitize=${PLUME_SANITIZE})
endif()

# plume_add_library(<name> SOURCES <files…> SEES <libraries…>)
# One library a folder. SEES lists the layers whose headers it may include; tools/check_layers.py holds it to that.
function(plume_add_library name)
  cmake_parse_arguments(LIB "" "" "SOURCES;SEES" ${ARGN})
  add_library(${name} STATIC ${LIB_SOURCES})
  target_include_directories(${name} PUBLIC ${CMAKE_SOURCE_DIR}/src)
  target_link_libraries(${name} PUBLIC ${LIB_SEES} PRIVATE plume_options)
endfunction()

# plume_compile_alone(<files…>)
# Where the sources of a folder are compiled several at a time (CMAKE_UNITY_BUILD, which saves most of the time that headers
# take), these are not: a name of theirs means something else in another file of the folder.
function(plume_compile_alone)
  set_source_files_properties(${ARGN} PROPERTIES SKIP_UNITY_BUILD_INCLUSION ON)
endfunction()

# For the sources of tests: what they test is optimised as the build says, they themselves are compiled in half the time.
function(plume_compile_fast name)
  target_compile_options(${name} PRIVATE -O0 -g1)
endfunction()

# All tests with the label "threads".
add_custom_target(threads_tests)

# plume_test(<name> SOURCES <files…> SEES <libraries…> [LABELS <labels…>] [ENVIRONMENT <variables…>])
# The label "threads" is for what ThreadSanitizer should watch.
function(plume_test name)
  cmake_parse_arguments(TEST "" "" "SOURCES;SEES;LABELS;ENVIRONMENT" ${ARGN})
  add_executable(${name} ${TEST_SOURCES})
  target_include_directories(${name} PRIVATE ${CMAKE_SOURCE_DIR})
  target_link_libraries(${name} PRIVATE ${TEST_SEES} plume_options GTest::gmock GTest::gtest_main)
  plume_compile_fast(${name})
  set(properties TIMEOUT 300)
  if("threads" IN_LIST TEST_LABELS)
    add_dependencies(threads_tests ${name})
  endif()
  if(TEST_LABELS)
    list(APPEND properties LABELS "${TEST_LABELS}")
  endif()
  if(TEST_ENVIRONMENT)
    list(APPEND properties ENVIRONMENT "${TEST_ENVIRONMENT}")
  endif()
  gtest_discover_tests(${name} DISCOVERY_MODE PRE_TEST WORKING_DIRECTORY ${CMAKE_SOURCE_DIR} PROPERTIES ${properties})
endfunction()

# plume_add_qt_library(<name> SOURCES <files…> SEES <libraries…>): a folder with windows.
function(plume_add_qt_library name)
  plume_add_library(${name} ${ARGN})
  set_target_properties(${name} PROPERTIES AUTOMOC ON)
  target_link_libraries(${name} PUBLIC Qt6::Widgets Qt6::DBus)
  target_compile_definitions(${name} PRIVATE QT_NO_CAST_TO_ASCII QT_NO_FOREACH QT_NO_KEYWORDS)
endfunction()

# The same as plume_test, for tests of windows.
function(plume_qt_test name)
  cmake_parse_arguments(TEST "" "" "SOURCES" ${ARGN})
  plume_test(${name} SOURCES ${CMAKE_SOURCE_DIR}/tests/support/OffscreenMain.cpp ${TEST_SOURCES} ${TEST_UNPARSED_ARGUMENTS})
  target_link_libraries(${name} PRIVATE Qt6::Test)
  add_dependencies(${name} plume_translation_files)
endfunction()
