# Unit and integration tests: every tests/**/*.cpp joins one GoogleTest binary.
find_package(GTest REQUIRED)
include(GoogleTest)

file(GLOB_RECURSE TEST_SOURCES CONFIGURE_DEPENDS ${CMAKE_SOURCE_DIR}/tests/*.cpp)
list(FILTER TEST_SOURCES EXCLUDE REGEX "/tests/(support|windows)/")
file(GLOB TEST_SUPPORT_SOURCES CONFIGURE_DEPENDS ${CMAKE_SOURCE_DIR}/tests/support/*.cpp)

add_executable(brakmorph_tests ${TEST_SOURCES} ${TEST_SUPPORT_SOURCES})
target_include_directories(brakmorph_tests PRIVATE ${CMAKE_SOURCE_DIR}/tests ${CMAKE_SOURCE_DIR})
target_link_libraries(brakmorph_tests PRIVATE brakmorph_core brakmorph_resources GTest::gtest GTest::gtest_main pthread)
target_compile_definitions(brakmorph_tests PRIVATE
  BRAKMORPH_TEST_PLUGIN="$<TARGET_FILE:Brakmorph>"
  BRAKMORPH_TEST_CLI="$<TARGET_FILE:brakmorph>"
  BRAKMORPH_GEN_DIR="${BRAKMORPH_GEN_DIR}")
add_dependencies(brakmorph_tests Brakmorph brakmorph)
gtest_discover_tests(brakmorph_tests DISCOVERY_TIMEOUT 60 PROPERTIES LABELS unit)
