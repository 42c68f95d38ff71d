// A minimal VST 2 host for the real-time checks: loads a module with dlopen,
// opens and resumes one instance, and answers the plug-in's callbacks from
// fixed storage so that answering never allocates.
#pragma once

#include <atomic>
#include <cstdint>
#include <string>

#include "host/vst2_abi.h"

namespace plugcore {

class QuietHost {
 public:
  // Loads and opens; check error() afterwards (gtest assertions live in tests).
  QuietHost(const std::string& module_path, float sample_rate, int max_block);
  ~QuietHost();
  QuietHost(const QuietHost&) = delete;
  QuietHost& operator=(const QuietHost&) = delete;

  const std::string& error() const { return error_; }
  AEffect* effect() const { return effect_; }

  intptr_t dispatch(int32_t opcode, int32_t index = 0, intptr_t value = 0, void* ptr = nullptr,
                    float opt = 0.0f);
  void resume();
  void suspend();

  // Index of the parameter whose effGetParamName equals name, or -1.
  int find_param(const std::string& name);

  // The tempo the time information reports; may change between blocks.
  static void set_tempo(double bpm);
  // How often the plug-in asked for each callback opcode since the last reset.
  static long callback_count(int32_t opcode);
  static void reset_callback_counts();

 private:
  static intptr_t VST2_CALL callback(AEffect* effect, int32_t opcode, int32_t index,
                                     intptr_t value, void* ptr, float opt);

  void* module_ = nullptr;
  AEffect* effect_ = nullptr;
  bool opened_ = false;
  bool resumed_ = false;
  std::string error_;
};

}  // namespace plugcore
