# How every target of the project is compiled.

add_library(pelorus_compile INTERFACE)
target_include_directories(pelorus_compile INTERFACE ${PROJECT_SOURCE_DIR})
target_compile_definitions(pelorus_compile INTERFACE QT_NO_KEYWORDS)
target_compile_options(pelorus_compile INTERFACE -Wall -Wextra -Wpedantic
                                                 $<$<CXX_COMPILER_ID:GNU>:-Wshadow=local> -Wconversion
                                                 -Wnon-virtual-dtor -Woverloaded-virtual -fno-math-errno)
if(PELORUS_WARNINGS_AS_ERRORS)
  target_compile_options(pelorus_compile INTERFACE -Werror)
endif()
# What makes a defect harder to exploit. The sanitizers catch more, and do not go together with it.
if(PELORUS_HARDENING AND NOT PELORUS_SANITIZE)
  include(CheckPIESupported)
  check_pie_supported()
  set(CMAKE_POSITION_INDEPENDENT_CODE ON)
  target_compile_options(pelorus_compile INTERFACE -fstack-protector-strong -fstack-clash-protection
                                                   $<$<NOT:$<CONFIG:Debug>>:-U_FORTIFY_SOURCE>
                                                   $<$<NOT:$<CONFIG:Debug>>:-D_FORTIFY_SOURCE=2>)
  target_link_options(pelorus_compile INTERFACE -Wl,-z,relro -Wl,-z,now -Wl,-z,noexecstack)
endif()
if(PELORUS_COVERAGE)
  target_compile_options(pelorus_compile INTERFACE --coverage)
  target_link_options(pelorus_compile INTERFACE --coverage)
endif()
if(PELORUS_SANITIZE)
  target_compile_options(pelorus_compile INTERFACE -fsanitize=${PELORUS_SANITIZE} -fno-sanitize-recover=all
                                                   -fno-omit-frame-pointer -g)
  target_link_options(pelorus_compile INTERFACE -fsanitize=${PELORUS_SANITIZE})
  # GCC's manual: under sanitizers this warning is wrong too often for -Werror. The plain build keeps it.
  target_compile_options(pelorus_compile INTERFACE -Wno-maybe-uninitialized)
endif()

# pelorus_library(NAME LIBRARIES...): a static library of the sources in the current folder.
function(pelorus_library name)
  file(GLOB sources CONFIGURE_DEPENDS *.cpp)
  if(NOT sources)
    add_library(${name} INTERFACE)
    return()
  endif()
  add_library(${name} STATIC ${sources})
  target_link_libraries(${name} PUBLIC pelorus_compile ${ARGN})
endfunction()

# pelorus_program(NAME LIBRARIES...): a program of the sources in the current folder.
function(pelorus_program name)
  file(GLOB sources CONFIGURE_DEPENDS *.cpp)
  add_executable(${name} ${sources})
  target_link_libraries(${name} PRIVATE pelorus_compile ${ARGN})
  install(TARGETS ${name})
endfunction()

# pelorus_test(FOLDER LIBRARIES...): the tests in one folder below tests/.
function(pelorus_test folder)
  file(GLOB sources CONFIGURE_DEPENDS ${folder}/*.cpp)
  if(NOT sources)
    return()
  endif()
  add_executable(test_${folder} ${sources})
  target_link_libraries(test_${folder} PRIVATE pelorus_compile GTest::gmock_main ${ARGN})
  # What is tested is optimised as always; optimising the tests themselves takes most of the time of a build, and their
  # headers most of the rest.
  target_compile_options(test_${folder} PRIVATE -O0)
  # To GCC a source that a unity build includes is a header, which should have no unnamed namespace.
  target_compile_options(test_${folder} PRIVATE $<$<CXX_COMPILER_ID:GNU>:-Wno-subobject-linkage>)
  set_target_properties(test_${folder} PROPERTIES UNITY_BUILD ON UNITY_BUILD_BATCH_SIZE 12
                                                  RUNTIME_OUTPUT_DIRECTORY ${PROJECT_BINARY_DIR}/tests)
  gtest_discover_tests(test_${folder} TEST_PREFIX "${folder}." DISCOVERY_TIMEOUT 120)
endfunction()

# pelorus_compile_singly(TARGET...): not in a unity build. Files that say the same kind of thing call it by the same names
# (Layout, kRows), each in its unnamed namespace.
function(pelorus_compile_singly)
  set_target_properties(${ARGN} PROPERTIES UNITY_BUILD OFF)
endfunction()

# pelorus_precompile(TARGET): the standard library's headers are read once for the target, which has many small sources.
function(pelorus_precompile target)
  target_precompile_headers(${target} PRIVATE <algorithm> <array> <chrono> <functional> <memory> <optional> <span> <string>
                                              <string_view> <unordered_map> <variant> <vector> <fmt/format.h>)
endfunction()
