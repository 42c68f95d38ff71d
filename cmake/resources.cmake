# The module's embedded resources: the factory bank and the skin.
# The Linux build generates them; cross builds for Windows take them from its
# generated folder, since the generators run on the build machine.
set(BRAKMORPH_GEN_DIR ${CMAKE_BINARY_DIR}/gen CACHE PATH "Folder of the generated resources")
set(BRAKMORPH_FACTORY_BANK ${BRAKMORPH_GEN_DIR}/factory_bank.pbk)
include(${CMAKE_CURRENT_LIST_DIR}/skin.cmake)

if(WIN32)
  if(NOT EXISTS ${BRAKMORPH_FACTORY_BANK})
    message(FATAL_ERROR "Generated resources missing in ${BRAKMORPH_GEN_DIR}: build the Linux tree first")
  endif()
  enable_language(RC)
  set(BRAKMORPH_RC_FILE ${CMAKE_BINARY_DIR}/brakmorph_resources.rc)
  file(WRITE ${BRAKMORPH_RC_FILE}
    "DEFAULT_PRESET_BANK VLPB \"${BRAKMORPH_FACTORY_BANK}\"\n"
    "STATIC_PRESETS VLPB \"${BRAKMORPH_FACTORY_BANK}\"\n"
    "${BRAKMORPH_SKIN_RC_LINES}")
  set_source_files_properties(${BRAKMORPH_RC_FILE} PROPERTIES OBJECT_DEPENDS
                              "${BRAKMORPH_FACTORY_BANK};${BRAKMORPH_SKIN_FILES}")
else()
  add_custom_command(
    OUTPUT ${BRAKMORPH_FACTORY_BANK}
    COMMAND ${CMAKE_COMMAND} -E make_directory ${BRAKMORPH_GEN_DIR}
    COMMAND make_factory_bank ${BRAKMORPH_FACTORY_BANK}
    DEPENDS make_factory_bank
    COMMENT "Writing the factory bank")
  add_custom_command(
    OUTPUT ${BRAKMORPH_GEN_DIR}/resource_table.cpp
    COMMAND make_resource_table ${BRAKMORPH_GEN_DIR}/resource_table.cpp
            VLPB DEFAULT_PRESET_BANK ${BRAKMORPH_FACTORY_BANK}
            VLPB STATIC_PRESETS ${BRAKMORPH_FACTORY_BANK}
            ${BRAKMORPH_SKIN_TABLE_ARGS}
    DEPENDS make_resource_table ${BRAKMORPH_FACTORY_BANK} ${BRAKMORPH_SKIN_FILES}
    COMMENT "Embedding the resources")
  add_library(brakmorph_resources STATIC ${BRAKMORPH_GEN_DIR}/resource_table.cpp)
  target_include_directories(brakmorph_resources PRIVATE ${CMAKE_SOURCE_DIR}/src)
  add_custom_target(generated_resources DEPENDS ${BRAKMORPH_FACTORY_BANK})
endif()
