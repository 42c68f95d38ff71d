# Build tools that run on the build machine.
add_executable(make_factory_bank ${CMAKE_SOURCE_DIR}/tools/make_factory_bank.cpp)
target_link_libraries(make_factory_bank PRIVATE brakmorph_core)
add_executable(make_resource_table ${CMAKE_SOURCE_DIR}/tools/make_resource_table.cpp)
