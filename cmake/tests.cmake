# Unit and integration tests: every tests/**/*.cpp joins one GoogleTest binary.
find_package(GTest REQUIRED)
include(GoogleTest)

file(GLOB_RECURSE TEST_SOURCES CONFIGURE_DEPENDS ${CMAKE_SOURCE_DIR}/tests/*.cpp)
list(FILTER TEST_SOURCES EXCLUDE REGEX "/tests/(support|windows|realtime|integration|ardour|cli/fake_plugin)/")
file(GLOB TEST_SUPPORT_SOURCES CONFIGURE_DEPENDS ${CMAKE_SOURCE_DIR}/tests/support/*.cpp)

add_executable(brakmorph_tests ${TEST_SOURCES} ${TEST_SUPPORT_SOURCES})
target_include_directories(brakmorph_tests PRIVATE ${CMAKE_SOURCE_DIR}/tests ${CMAKE_SOURCE_DIR})
target_link_libraries(brakmorph_tests PRIVATE brakmorph_core brakmorph_resources GTest::gtest GTest::gtest_main pthread)
target_compile_definitions(brakmorph_tests PRIVATE
  BRAKMORPH_TEST_PLUGIN="$<TARGET_FILE:Brakmorph>"
  BRAKMORPH_GEN_DIR="${BRAKMORPH_GEN_DIR}")
add_dependencies(brakmorph_tests Brakmorph)
if(TARGET brakmorph)
  target_compile_definitions(brakmorph_tests PRIVATE BRAKMORPH_TEST_CLI="$<TARGET_FILE:brakmorph>")
  add_dependencies(brakmorph_tests brakmorph)
endif()
gtest_discover_tests(brakmorph_tests DISCOVERY_TIMEOUT 60 PROPERTIES LABELS unit)

# Real-time safety of the audio path: its own executable, because it replaces
# malloc, operator new and the mutex calls process-wide. A sanitizer runtime
# replaces the same functions, so sanitized trees leave it out.
if(NOT BRAKMORPH_SANITIZE)
  file(GLOB REALTIME_TEST_SOURCES CONFIGURE_DEPENDS ${CMAKE_SOURCE_DIR}/tests/realtime/*.cpp)
  add_executable(realtime_tests ${REALTIME_TEST_SOURCES})
  target_include_directories(realtime_tests PRIVATE ${CMAKE_SOURCE_DIR}/tests ${CMAKE_SOURCE_DIR}/src)
  target_link_libraries(realtime_tests PRIVATE GTest::gtest GTest::gtest_main pthread ${CMAKE_DL_LIBS})
  target_compile_definitions(realtime_tests PRIVATE BRAKMORPH_TEST_PLUGIN="$<TARGET_FILE:Brakmorph>")
  # Export the replacements so a dlopen'ed module binds to them.
  set_target_properties(realtime_tests PROPERTIES ENABLE_EXPORTS ON)
  add_dependencies(realtime_tests Brakmorph)
  gtest_discover_tests(realtime_tests DISCOVERY_TIMEOUT 60 PROPERTIES LABELS realtime)
endif()

# Integration with the outside world: the Windows builds under Wine, a
# third-party host's plug-in scanner, and the command-line host on a
# third-party plug-in. Each script exits 77 (skipped) when what it needs is
# not installed.
set(BRAKMORPH_WINDOWS_BUILDS "" CACHE STRING "Build folders of the Windows plug-ins, a ;-list")
add_executable(raw_signal_tool ${CMAKE_SOURCE_DIR}/tests/integration/raw_signal_tool.cpp)
if(TARGET brakmorph)
  string(REPLACE ";" ":" BRAKMORPH_WINDOWS_BUILD_PATH "${BRAKMORPH_WINDOWS_BUILDS}")
  set(INTEGRATION_DIR ${CMAKE_SOURCE_DIR}/tests/integration)
  set(INTEGRATION_WORK ${CMAKE_BINARY_DIR}/integration)
  add_test(NAME integration.wine_cross_build
           COMMAND bash ${INTEGRATION_DIR}/wine_cross_build.sh
                   --cli $<TARGET_FILE:brakmorph> --tool $<TARGET_FILE:raw_signal_tool>
                   --plugin $<TARGET_FILE:Brakmorph> --work ${INTEGRATION_WORK}/wine
                   --windows-builds "${BRAKMORPH_WINDOWS_BUILD_PATH}")
  add_test(NAME integration.ardour_scan
           COMMAND bash ${INTEGRATION_DIR}/ardour_scan.sh
                   --plugin $<TARGET_FILE:Brakmorph> --work ${INTEGRATION_WORK}/ardour)
  add_test(NAME integration.lsp_bench
           COMMAND bash ${INTEGRATION_DIR}/lsp_bench.sh --cli $<TARGET_FILE:brakmorph>)
  set_tests_properties(integration.wine_cross_build integration.ardour_scan integration.lsp_bench
                       PROPERTIES LABELS integration SKIP_RETURN_CODE 77)
  set_tests_properties(integration.wine_cross_build PROPERTIES TIMEOUT 900)
  set_tests_properties(integration.ardour_scan integration.lsp_bench PROPERTIES TIMEOUT 300)
  # The validation battery: each Windows build under Wine (sharing the Wine
  # prefix above, so the two never run at once), and the Linux host on a
  # third-party plug-in, which must run to completion whatever it fails.
  add_test(NAME integration.wine_validate
           COMMAND bash ${CMAKE_SOURCE_DIR}/tests/validate/wine_validate.sh
                   --prefix ${INTEGRATION_WORK}/wine/prefix
                   --windows-builds "${BRAKMORPH_WINDOWS_BUILD_PATH}")
  add_test(NAME integration.lsp_validate
           COMMAND bash ${CMAKE_SOURCE_DIR}/tests/validate/lsp_validate.sh --cli $<TARGET_FILE:brakmorph>)
  set_tests_properties(integration.wine_validate integration.lsp_validate
                       PROPERTIES LABELS integration SKIP_RETURN_CODE 77 TIMEOUT 600)
  add_test(NAME integration.wine_registry
           COMMAND bash ${INTEGRATION_DIR}/wine_registry.sh
                   --prefix ${INTEGRATION_WORK}/wine/prefix
                   --windows-builds "${BRAKMORPH_WINDOWS_BUILD_PATH}")
  set_tests_properties(integration.wine_registry
                       PROPERTIES LABELS integration SKIP_RETURN_CODE 77 TIMEOUT 600)
  # A real host end to end: record, export, save, reload and export again in
  # the host's headless session runner, compared with the command-line render.
  add_executable(ardour_wav_tool ${CMAKE_SOURCE_DIR}/tests/ardour/wav_tool.cpp)
  target_link_libraries(ardour_wav_tool PRIVATE ${BRAKMORPH_SNDFILE_LIB})
  add_test(NAME integration.ardour_session
           COMMAND bash ${CMAKE_SOURCE_DIR}/tests/ardour/run_session_route.sh
                   --cli $<TARGET_FILE:brakmorph> --plugin $<TARGET_FILE:Brakmorph>
                   --tool $<TARGET_FILE:ardour_wav_tool> --work ${INTEGRATION_WORK}/ardour_session)
  set_tests_properties(integration.ardour_session
                       PROPERTIES LABELS integration SKIP_RETURN_CODE 77 TIMEOUT 240)
  # Editors in real X windows on a virtual server: the editor commands' tests
  # (the snapshots stay in snapshots/ of the build tree) and the validator's
  # editor checks on the plug-in.
  add_test(NAME integration.editor_xvfb
           COMMAND bash ${CMAKE_SOURCE_DIR}/tests/cli/run_under_xvfb.sh
                   $<TARGET_FILE:brakmorph_tests> --gtest_filter=EditorHost* --gtest_brief=1)
  add_test(NAME integration.validate_editor_xvfb
           COMMAND bash ${CMAKE_SOURCE_DIR}/tests/cli/run_under_xvfb.sh
                   $<TARGET_FILE:brakmorph> validate --only editor --plugin $<TARGET_FILE:Brakmorph>)
  set_tests_properties(integration.editor_xvfb integration.validate_editor_xvfb
                       PROPERTIES LABELS integration SKIP_RETURN_CODE 77 TIMEOUT 120)
  # The Windows builds' editors under Wine on a virtual X server, sharing the
  # Wine prefix of the other Windows tests.
  add_test(NAME integration.wine_snapshots
           COMMAND bash ${CMAKE_SOURCE_DIR}/tests/cli/wine_snapshots.sh
                   --prefix ${INTEGRATION_WORK}/wine/prefix
                   --windows-builds "${BRAKMORPH_WINDOWS_BUILD_PATH}"
                   --out ${CMAKE_BINARY_DIR}/snapshots --tests $<TARGET_FILE:brakmorph_tests>)
  set_tests_properties(integration.wine_snapshots
                       PROPERTIES LABELS integration SKIP_RETURN_CODE 77 TIMEOUT 600
                       RESOURCE_LOCK wine_prefix)
  # The editor window of each Windows build on a private X server.
  add_test(NAME integration.wine_window
           COMMAND bash ${INTEGRATION_DIR}/wine_window.sh
                   --prefix ${INTEGRATION_WORK}/wine/prefix
                   --windows-builds "${BRAKMORPH_WINDOWS_BUILD_PATH}")
  set_tests_properties(integration.wine_window
                       PROPERTIES LABELS integration SKIP_RETURN_CODE 77 TIMEOUT 600)
  set_tests_properties(integration.wine_cross_build integration.wine_validate integration.wine_registry
                       integration.wine_window PROPERTIES RESOURCE_LOCK wine_prefix)
endif()

# The editor window on a real X server: a virtual one, started for the run.
# XTest drives the pointer and keys; the screenshots are written as PNG.
target_link_libraries(brakmorph_tests PRIVATE Xtst png)
find_program(XVFB_RUN xvfb-run)
if(XVFB_RUN)
  add_test(NAME x11_window
           COMMAND ${XVFB_RUN} -a -s "-screen 0 1024x768x24" $<TARGET_FILE:brakmorph_tests> --gtest_filter=X11*)
  set_tests_properties(x11_window PROPERTIES LABELS window TIMEOUT 120
                       ENVIRONMENT "BRAKMORPH_SCREENSHOT_DIR=${CMAKE_BINARY_DIR}/screenshots;BRAKMORPH_NO_DESKTOP_TOOLS=1")
endif()
