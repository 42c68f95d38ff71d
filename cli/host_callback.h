// The host side of the plug-in callback: what this host tells a plug-in about
// itself, its transport and which pins carry signal.
#pragma once

#include <cstdint>

#include "host/vst2_abi.h"

namespace plugcore {

constexpr intptr_t kHostVstVersion = 2400;
constexpr double kHostTempoBpm = 120.0;

// One hosted instance's view of the host. The render loop advances the sample
// position; the callback reads everything else.
struct HostCallbackContext {
  double sample_rate = 48000.0;
  int32_t block_size = 512;
  int32_t connected_inputs = 2;   // pins below this index carry signal
  int32_t connected_outputs = 2;
  double sample_pos = 0.0;
  int32_t automate_calls = 0;     // audioMasterAutomate calls seen
  VstTimeInfo time_info{};        // storage handed out by audioMasterGetTime
};

// The callback every hosted plug-in receives.
intptr_t VST2_CALL host_callback(AEffect* effect, int32_t opcode, int32_t index, intptr_t value,
                                 void* ptr, float opt);

// Plug-ins call back before their effect record is known (during the entry
// call), so a context is first bound as pending, then tied to the record.
void bind_pending_context(HostCallbackContext* context);
void bind_context(AEffect* effect, HostCallbackContext* context);
void unbind_context(AEffect* effect);

// The host's answer to audioMasterCanDo for one capability text.
intptr_t host_can_do(const char* capability);

}  // namespace plugcore
