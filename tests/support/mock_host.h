#pragma once

#include <array>
#include <atomic>
#include <mutex>
#include <cstdint>
#include <string>
#include <vector>

#include "host/vst2_abi.h"

// A scriptable host for in-process tests of the plug-in core. The callback is a
// plain function, so one MockHost is "current" at a time per test.
struct MockHost {
  intptr_t version = 2400;
  intptr_t automatable = 0;
  intptr_t quantization = 0;
  intptr_t can_size_window = 0;
  bool second_input_connected = true;
  bool second_output_connected = true;
  bool time_info = true;
  double tempo = 120.0;

  struct Automation {
    int32_t index;
    float value;
  };
  std::vector<Automation> automations;
  std::atomic<int> want_midi_calls{0};
  std::atomic<int> update_display_calls{0};
  std::atomic<int> get_time_calls{0};
  std::atomic<int32_t> last_time_filter{-1};
  // audioMasterProcessEvents: one call per list, the MIDI bytes of every event.
  std::atomic<int> process_events_calls{0};
  std::mutex midi_out_mutex;
  std::vector<std::array<uint8_t, 4>> midi_out;
  std::vector<int32_t> midi_out_delta_frames;
  intptr_t process_events_answer = 1;

  MockHost();
  ~MockHost();
  static intptr_t VST2_CALL callback(AEffect* effect, int32_t opcode, int32_t index, intptr_t value, void* ptr,
                                      float opt);
};

// Dispatcher shorthand.
intptr_t dispatch(AEffect* effect, int32_t opcode, int32_t index = 0, intptr_t value = 0, void* ptr = nullptr,
                  float opt = 0.0f);
std::string param_text(AEffect* effect, int32_t opcode, int32_t index);
// Opens and switches on an instance the way hosts do.
void open_and_resume(AEffect* effect, float rate, int32_t block);
void close_instance(AEffect* effect);
