# Windows test host: renders raw audio through a plug-in DLL, linked
# statically so it runs under any Windows or Wine without the toolchain's DLLs.
get_filename_component(BRAKMORPH_WINTOOLS_ROOT ${CMAKE_CURRENT_LIST_DIR}/.. ABSOLUTE)

add_executable(win_render_host
  ${BRAKMORPH_WINTOOLS_ROOT}/tests/windows/win_render_host.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/host_callback.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/hosted_plugin.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/param_lookup.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/render_loop.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/raw_audio.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/validate/editor_session.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/validate/win32/editor_parent_win32.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/win32/dynamic_module_win32.cpp)
target_include_directories(win_render_host PRIVATE ${BRAKMORPH_WINTOOLS_ROOT}
                           ${BRAKMORPH_WINTOOLS_ROOT}/src)
# The snapshot mode copies the editor's window with GDI.
target_link_libraries(win_render_host PRIVATE gdi32)
target_link_options(win_render_host PRIVATE -static -static-libgcc -static-libstdc++)
set_target_properties(win_render_host PROPERTIES SUFFIX ".exe"
                      RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)

# The validation battery on its own, so it runs against the DLLs under Wine.
file(GLOB VALIDATE_SOURCES CONFIGURE_DEPENDS ${BRAKMORPH_WINTOOLS_ROOT}/cli/validate/*.cpp
     ${BRAKMORPH_WINTOOLS_ROOT}/cli/validate/win32/*.cpp)
add_executable(brakmorph_validate
  ${VALIDATE_SOURCES}
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/validate/standalone/validate_main.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/command_validate.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/command_args.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/help_text.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/json_text.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/host_callback.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/hosted_plugin.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/cli/win32/dynamic_module_win32.cpp)
target_include_directories(brakmorph_validate PRIVATE ${BRAKMORPH_WINTOOLS_ROOT}
                           ${BRAKMORPH_WINTOOLS_ROOT}/src)
# The editor checks make parent windows; their grab uses GDI.
target_link_libraries(brakmorph_validate PRIVATE gdi32)
target_link_options(brakmorph_validate PRIVATE -static -static-libgcc -static-libstdc++)
set_target_properties(brakmorph_validate PROPERTIES SUFFIX ".exe"
                      RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)

# The per-user value store against the real registry, for a script under Wine.
add_executable(registry_probe ${BRAKMORPH_WINTOOLS_ROOT}/tests/windows/registry_probe.cpp)
target_link_libraries(registry_probe PRIVATE brakmorph_core)
target_link_options(registry_probe PRIVATE -static -static-libgcc -static-libstdc++)
set_target_properties(registry_probe PROPERTIES SUFFIX ".exe"
                      RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)

# The editor window on the desktop (run under Wine with an X server by a
# script): the skin scene in a real window against its off-screen rendering.
add_executable(win_window_test
  ${BRAKMORPH_WINTOOLS_ROOT}/tests/windows/win_window_test.cpp
  ${BRAKMORPH_WINTOOLS_ROOT}/tests/support/skin_test_scene.cpp
  ${BRAKMORPH_RC_FILE})
target_include_directories(win_window_test PRIVATE ${BRAKMORPH_WINTOOLS_ROOT}/tests ${BRAKMORPH_WINTOOLS_ROOT}/src)
target_link_libraries(win_window_test PRIVATE brakmorph_core)
target_link_options(win_window_test PRIVATE -static -static-libgcc -static-libstdc++)
set_target_properties(win_window_test PROPERTIES SUFFIX ".exe"
                      RUNTIME_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/bin)
