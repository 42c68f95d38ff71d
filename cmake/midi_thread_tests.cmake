# ThreadSanitizer trees: the MIDI queue and device-switching tests as a small
# binary of their own, so the sanitized build need not compile every test.
if(BRAKMORPH_SANITIZE STREQUAL "thread")
  find_package(GTest REQUIRED)
  add_executable(midi_thread_tests ${CMAKE_SOURCE_DIR}/tests/midi/midi_queue_threads_test.cpp
                                   ${CMAKE_SOURCE_DIR}/tests/midi/midi_output_test.cpp
                                   ${CMAKE_SOURCE_DIR}/tests/midi/test_config_home.cpp)
  target_include_directories(midi_thread_tests PRIVATE ${CMAKE_SOURCE_DIR}/tests ${CMAKE_SOURCE_DIR})
  target_link_libraries(midi_thread_tests PRIVATE brakmorph_core brakmorph_resources GTest::gtest GTest::gtest_main pthread)
endif()
