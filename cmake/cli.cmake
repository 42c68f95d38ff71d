# The command-line host "brakmorph": the portable host logic and the Linux
# platform layer in a static library (the tests link it too), and the
# executable, which lands in ${CMAKE_BINARY_DIR}/bin so that its default
# plug-in path <bin>/../vst/Brakmorph.so finds the module built beside it.
get_filename_component(BRAKMORPH_CLI_ROOT ${CMAKE_CURRENT_LIST_DIR}/.. ABSOLUTE)

find_package(PkgConfig QUIET)
if(PKG_CONFIG_FOUND)
  pkg_check_modules(SNDFILE QUIET IMPORTED_TARGET sndfile)
endif()
if(TARGET PkgConfig::SNDFILE)
  set(BRAKMORPH_SNDFILE_LIB PkgConfig::SNDFILE)
else()
  find_library(BRAKMORPH_SNDFILE_LIB sndfile REQUIRED)
endif()

file(GLOB CLI_SOURCES CONFIGURE_DEPENDS ${BRAKMORPH_CLI_ROOT}/cli/*.cpp
     ${BRAKMORPH_CLI_ROOT}/cli/linux/*.cpp
     ${BRAKMORPH_CLI_ROOT}/cli/validate/*.cpp ${BRAKMORPH_CLI_ROOT}/cli/validate/linux/*.cpp)
list(REMOVE_ITEM CLI_SOURCES ${BRAKMORPH_CLI_ROOT}/cli/cli_main.cpp)

# The editor commands: an X window as the editor's parent, grabs saved as PNG.
pkg_check_modules(CLI_X11 REQUIRED IMPORTED_TARGET x11)
pkg_check_modules(CLI_PNG REQUIRED IMPORTED_TARGET libpng)

add_library(brakmorph_cli STATIC ${CLI_SOURCES})
target_include_directories(brakmorph_cli PUBLIC ${BRAKMORPH_CLI_ROOT} ${BRAKMORPH_CLI_ROOT}/src)
find_package(Threads REQUIRED)
target_link_libraries(brakmorph_cli PUBLIC ${BRAKMORPH_SNDFILE_LIB} PkgConfig::CLI_X11 PkgConfig::CLI_PNG
                      ${CMAKE_DL_LIBS} Threads::Threads)

add_executable(brakmorph ${BRAKMORPH_CLI_ROOT}/cli/cli_main.cpp)
target_link_libraries(brakmorph PRIVATE brakmorph_cli)
set_target_properties(brakmorph PROPERTIES RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)
# validate counts the allocations and locks of a plug-in's audio entries with
# the real-time tests' interposer, exported so a dlopen'ed module binds to it.
# A sanitizer runtime replaces the same functions, so sanitized trees go without.
if(NOT BRAKMORPH_SANITIZE)
  target_sources(brakmorph PRIVATE ${BRAKMORPH_CLI_ROOT}/tests/realtime/call_counter.cpp)
  target_include_directories(brakmorph PRIVATE ${BRAKMORPH_CLI_ROOT}/tests)
  set_target_properties(brakmorph PROPERTIES ENABLE_EXPORTS ON)
endif()

# The fake plug-in the host's tests run on.
include(${BRAKMORPH_CLI_ROOT}/tests/cli/fake_plugin/CMakeLists.txt)
# The plug-in with a plain X11 editor the editor commands' tests run on.
include(${BRAKMORPH_CLI_ROOT}/tests/cli/fake_editor_plugin/CMakeLists.txt)
# The faulty plug-in the validation battery's tests run on.
include(${BRAKMORPH_CLI_ROOT}/tests/validate/fake_plugin/CMakeLists.txt)

# Once every file of the tree is read: the test binary unit-tests the host
# logic and runs the host on the fake plug-in (tests/cli/fake_plugin), whose
# paths it receives as compile definitions.
function(brakmorph_cli_wire_tests)
  if(NOT TARGET brakmorph_tests)
    return()
  endif()
  target_link_libraries(brakmorph_tests PRIVATE brakmorph_cli)
  if(TARGET FakeGain AND TARGET FakeGainMainOnly)
    add_dependencies(brakmorph_tests FakeGain FakeGainMainOnly)
    target_compile_definitions(brakmorph_tests PRIVATE
      BRAKMORPH_TEST_FAKE_PLUGIN="$<TARGET_FILE:FakeGain>"
      BRAKMORPH_TEST_FAKE_PLUGIN_MAIN_ONLY="$<TARGET_FILE:FakeGainMainOnly>")
  endif()
  if(TARGET FakeEditor AND TARGET FakeEditorLeak)
    add_dependencies(brakmorph_tests FakeEditor FakeEditorLeak)
    target_compile_definitions(brakmorph_tests PRIVATE
      BRAKMORPH_TEST_FAKE_EDITOR="$<TARGET_FILE:FakeEditor>"
      BRAKMORPH_TEST_FAKE_EDITOR_LEAK="$<TARGET_FILE:FakeEditorLeak>"
      BRAKMORPH_TEST_SNAPSHOT_DIR="${CMAKE_BINARY_DIR}/snapshots")
  endif()
endfunction()
cmake_language(DEFER DIRECTORY ${CMAKE_SOURCE_DIR} CALL brakmorph_cli_wire_tests)
