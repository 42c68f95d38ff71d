# The plug-in module: the entry point, the core and the embedded resources.
if(WIN32)
  add_library(Brakmorph MODULE ${CMAKE_SOURCE_DIR}/src/host/plugin_entry.cpp
              ${CMAKE_SOURCE_DIR}/src/host/win32/brakmorph.def ${BRAKMORPH_RC_FILE})
  target_link_libraries(Brakmorph PRIVATE brakmorph_core)
  # Only system DLLs at run time.
  target_link_options(Brakmorph PRIVATE -static -static-libgcc -static-libstdc++)
  set_target_properties(Brakmorph PROPERTIES PREFIX "" SUFFIX ".dll"
                        LIBRARY_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/vst)
else()
  add_library(Brakmorph MODULE ${CMAKE_SOURCE_DIR}/src/host/plugin_entry.cpp)
  target_link_libraries(Brakmorph PRIVATE brakmorph_core brakmorph_resources)
  target_link_options(Brakmorph PRIVATE
                      -Wl,--version-script=${CMAKE_SOURCE_DIR}/src/host/linux/exports.map)
  # Shipped modules carry their C++ runtime. Sanitized trees share the host's:
  # a static runtime's exception pool stays behind on dlclose and the leak
  # checker would report it in every host that unloads the module.
  if(NOT BRAKMORPH_SANITIZE)
    target_link_options(Brakmorph PRIVATE -static-libgcc -static-libstdc++)
  endif()
  set_target_properties(Brakmorph PROPERTIES PREFIX "" SUFFIX ".so"
                        LIBRARY_OUTPUT_DIRECTORY ${CMAKE_BINARY_DIR}/vst)
endif()
set_target_properties(Brakmorph PROPERTIES CXX_VISIBILITY_PRESET hidden)
