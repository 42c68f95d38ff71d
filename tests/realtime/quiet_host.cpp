#include "realtime/quiet_host.h"

#include <dlfcn.h>

#include <cstring>

namespace plugcore {
namespace {

constexpr int kOpcodeSlots = 64;
std::atomic<long> g_callback_counts[kOpcodeSlots];
std::atomic<double> g_tempo{120.0};
float g_sample_rate = 48000.0f;
int g_block_size = 4096;
VstTimeInfo g_time_info;

using EntryFunction = AEffect* (*)(Vst2HostCallback);

intptr_t answer_can_do(const char* feature) {
  static const char* const kYes[] = {"sendVstEvents", "sendVstMidiEvent", "sendVstTimeInfo",
                                     "receiveVstEvents", "receiveVstMidiEvent"};
  if (feature == nullptr) {
    return 0;
  }
  for (const char* yes : kYes) {
    if (std::strcmp(feature, yes) == 0) {
      return 1;
    }
  }
  return -1;
}

}  // namespace

QuietHost::QuietHost(const std::string& module_path, float sample_rate, int max_block) {
  g_sample_rate = sample_rate;
  g_block_size = max_block;
  module_ = dlopen(module_path.c_str(), RTLD_NOW | RTLD_LOCAL);
  if (module_ == nullptr) {
    const char* reason = dlerror();
    error_ = "cannot load " + module_path + ": " + (reason != nullptr ? reason : "?");
    return;
  }
  void* entry = dlsym(module_, "VSTPluginMain");
  if (entry == nullptr) {
    entry = dlsym(module_, "main");
  }
  if (entry == nullptr) {
    error_ = "no VSTPluginMain or main in " + module_path;
    return;
  }
  effect_ = reinterpret_cast<EntryFunction>(entry)(&QuietHost::callback);
  if (effect_ == nullptr) {
    error_ = "the entry returned no instance";
    return;
  }
  if (effect_->magic != kVstMagic) {
    error_ = "bad magic";
    effect_ = nullptr;
    return;
  }
  dispatch(effOpen);
  opened_ = true;
  dispatch(effSetSampleRate, 0, 0, nullptr, sample_rate);
  dispatch(effSetBlockSize, 0, max_block);
}

QuietHost::~QuietHost() {
  if (effect_ != nullptr) {
    suspend();
    if (opened_) {
      dispatch(effClose);
    }
  }
  if (module_ != nullptr) {
    dlclose(module_);
  }
}

intptr_t QuietHost::dispatch(int32_t opcode, int32_t index, intptr_t value, void* ptr, float opt) {
  return effect_->dispatcher(effect_, opcode, index, value, ptr, opt);
}

void QuietHost::resume() {
  if (!resumed_) {
    dispatch(effMainsChanged, 0, 1);
    resumed_ = true;
  }
}

void QuietHost::suspend() {
  if (resumed_) {
    dispatch(effMainsChanged, 0, 0);
    resumed_ = false;
  }
}

int QuietHost::find_param(const std::string& name) {
  for (int index = 0; index < effect_->numParams; ++index) {
    char text[256] = {};
    dispatch(effGetParamName, index, 0, text);
    if (name == text) {
      return index;
    }
  }
  return -1;
}

void QuietHost::set_tempo(double bpm) { g_tempo.store(bpm, std::memory_order_relaxed); }

long QuietHost::callback_count(int32_t opcode) {
  if (opcode < 0 || opcode >= kOpcodeSlots) {
    return 0;
  }
  return g_callback_counts[opcode].load(std::memory_order_relaxed);
}

void QuietHost::reset_callback_counts() {
  for (auto& slot : g_callback_counts) {
    slot.store(0, std::memory_order_relaxed);
  }
}

intptr_t VST2_CALL QuietHost::callback(AEffect*, int32_t opcode, int32_t, intptr_t value,
                                       void* ptr, float) {
  if (opcode >= 0 && opcode < kOpcodeSlots) {
    g_callback_counts[opcode].fetch_add(1, std::memory_order_relaxed);
  }
  switch (opcode) {
    case audioMasterVersion:
      return 2400;
    case audioMasterGetTime:
      g_time_info = VstTimeInfo{};
      g_time_info.sampleRate = g_sample_rate;
      g_time_info.tempo = g_tempo.load(std::memory_order_relaxed);
      g_time_info.timeSigNumerator = 4;
      g_time_info.timeSigDenominator = 4;
      g_time_info.flags = kVstTransportPlaying | kVstTempoValid | kVstTimeSigValid;
      return reinterpret_cast<intptr_t>(&g_time_info);
    case audioMasterPinConnected:
      return 0;  // every pin connected
    case audioMasterGetSampleRate:
      return static_cast<intptr_t>(g_sample_rate);
    case audioMasterGetBlockSize:
      return g_block_size;
    case audioMasterCanDo:
      return answer_can_do(static_cast<const char*>(ptr));
    case audioMasterGetCurrentProcessLevel:
      return 2;  // real-time
    default:
      (void)value;
      return 0;
  }
}

}  // namespace plugcore
