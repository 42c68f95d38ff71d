#include "cli/host_callback.h"

#include <cmath>
#include <cstring>

namespace plugcore {
namespace {

// The host runs on one thread; a small table maps effect records to contexts.
constexpr int kMaxBound = 64;
struct Binding {
  AEffect* effect;
  HostCallbackContext* context;
};
Binding g_bindings[kMaxBound] = {};
HostCallbackContext* g_pending = nullptr;
HostCallbackContext g_fallback;

HostCallbackContext& context_for(AEffect* effect) {
  if (effect != nullptr) {
    for (const Binding& binding : g_bindings) {
      if (binding.effect == effect) {
        return *binding.context;
      }
    }
  }
  return g_pending != nullptr ? *g_pending : g_fallback;
}

struct CanDoAnswer {
  const char* capability;
  intptr_t answer;  // 1 yes, -1 no
};

const CanDoAnswer kCanDoTable[] = {
    {"sendVstTimeInfo", 1},
    {"supplyIdle", 1},
    {"sendVstEvents", -1},
    {"sendVstMidiEvent", -1},
    {"receiveVstEvents", -1},
    {"receiveVstMidiEvent", -1},
    {"reportConnectionChanges", -1},
    {"acceptIOChanges", -1},
    {"sizeWindow", -1},
    {"offline", -1},
    {"openFileSelector", -1},
    {"closeFileSelector", -1},
    {"startStopProcess", -1},
    {"shellCategory", -1},
    {"sendVstMidiEventFlagIsRealtime", -1},
};

VstTimeInfo* fill_time_info(HostCallbackContext& context, intptr_t wanted) {
  VstTimeInfo& info = context.time_info;
  std::memset(&info, 0, sizeof(info));
  info.samplePos = context.sample_pos;
  info.sampleRate = context.sample_rate;
  info.flags = kVstTransportPlaying;
  const double seconds = context.sample_pos / context.sample_rate;
  const double ppq = seconds * kHostTempoBpm / 60.0;
  if ((wanted & kVstTempoValid) != 0) {
    info.tempo = kHostTempoBpm;
    info.flags |= kVstTempoValid;
  }
  if ((wanted & kVstPpqPosValid) != 0) {
    info.ppqPos = ppq;
    info.flags |= kVstPpqPosValid;
  }
  if ((wanted & kVstBarsValid) != 0) {
    info.barStartPos = std::floor(ppq / 4.0) * 4.0;
    info.flags |= kVstBarsValid;
  }
  if ((wanted & kVstTimeSigValid) != 0) {
    info.timeSigNumerator = 4;
    info.timeSigDenominator = 4;
    info.flags |= kVstTimeSigValid;
  }
  if ((wanted & kVstNanosValid) != 0) {
    info.nanoSeconds = seconds * 1e9;
    info.flags |= kVstNanosValid;
  }
  return &info;
}

// audioMasterPinConnected answers 0 for a connected pin.
intptr_t pin_answer(const HostCallbackContext& context, int32_t pin, intptr_t is_output) {
  const int32_t connected = is_output != 0 ? context.connected_outputs : context.connected_inputs;
  return pin >= 0 && pin < connected ? 0 : 1;
}

}  // namespace

void bind_pending_context(HostCallbackContext* context) { g_pending = context; }

void bind_context(AEffect* effect, HostCallbackContext* context) {
  for (Binding& binding : g_bindings) {
    if (binding.effect == nullptr || binding.effect == effect) {
      binding.effect = effect;
      binding.context = context;
      return;
    }
  }
}

void unbind_context(AEffect* effect) {
  for (Binding& binding : g_bindings) {
    if (binding.effect == effect) {
      binding = Binding{nullptr, nullptr};
    }
  }
}

intptr_t host_can_do(const char* capability) {
  if (capability == nullptr) {
    return 0;
  }
  for (const CanDoAnswer& entry : kCanDoTable) {
    if (std::strcmp(entry.capability, capability) == 0) {
      return entry.answer;
    }
  }
  return 0;
}

intptr_t VST2_CALL host_callback(AEffect* effect, int32_t opcode, int32_t index, intptr_t value,
                                 void* ptr, float opt) {
  HostCallbackContext& context = context_for(effect);
  switch (opcode) {
    case audioMasterVersion:
      return kHostVstVersion;
    case audioMasterAutomate:
      ++context.automate_calls;
      return 0;
    case audioMasterGetTime:
      return reinterpret_cast<intptr_t>(fill_time_info(context, value));
    case audioMasterPinConnected:
      return pin_answer(context, index, value);
    case audioMasterCanDo:
      return host_can_do(static_cast<const char*>(ptr));
    case audioMasterGetSampleRate:
      return static_cast<intptr_t>(context.sample_rate);
    case audioMasterGetBlockSize:
      return context.block_size;
    case audioMasterGetNumAutomatableParameters:
      return 0;  // unknown: the plug-in offers everything
    default:
      return 0;
  }
}

}  // namespace plugcore
