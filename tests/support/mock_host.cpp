#include "support/mock_host.h"

#include <cstring>
#include <mutex>

namespace {
MockHost* g_current = nullptr;
}

MockHost::MockHost() { g_current = this; }

MockHost::~MockHost() {
  if (g_current == this) {
    g_current = nullptr;
  }
}

intptr_t VST2_CALL MockHost::callback(AEffect* effect, int32_t opcode, int32_t index, intptr_t value, void* ptr,
                                      float opt) {
  MockHost* host = g_current;
  if (host == nullptr) {
    return opcode == audioMasterVersion ? 2400 : 0;
  }
  switch (opcode) {
    case audioMasterVersion: return host->version;
    case audioMasterAutomate: host->automations.push_back({index, opt}); return 0;
    case audioMasterPinConnected: {
      // 0 means connected; pin 1 of either direction can be switched off.
      const bool output = value != 0;
      const bool connected = index == 0 || (output ? host->second_output_connected : host->second_input_connected);
      return connected ? 0 : 1;
    }
    case audioMasterWantMidi: host->want_midi_calls++; return 1;
    case audioMasterGetTime:
      host->get_time_calls++;
      host->last_time_filter = static_cast<int32_t>(value);
      if (!host->time_info) {
        return 0;
      }
{
      // One record per calling thread, as instances may process concurrently.
      static thread_local VstTimeInfo info;
      std::memset(&info, 0, sizeof(info));
      info.sampleRate = 48000.0;
      info.tempo = host->tempo;
      info.flags = host->tempo > 0.0 ? kVstTempoValid : 0;
      return reinterpret_cast<intptr_t>(&info);
    }
    case audioMasterGetNumAutomatableParameters: return host->automatable;
    case audioMasterGetParameterQuantization: return host->quantization;
    case audioMasterCanDo:
      return ptr != nullptr && std::strcmp(static_cast<const char*>(ptr), "sizeWindow") == 0 ? host->can_size_window
                                                                                              : 0;
    case audioMasterUpdateDisplay: host->update_display_calls++; return 1;
    case audioMasterProcessEvents: {
      host->process_events_calls++;
      // Instances may process on several threads at once.
      std::lock_guard<std::mutex> lock(host->midi_out_mutex);
      const auto* list = static_cast<const VstEvents*>(ptr);
      for (int32_t i = 0; list != nullptr && i < list->numEvents; ++i) {
        const VstEvent* event = list->events[i];
        if (event == nullptr || event->type != kVstMidiType) continue;
        const auto* midi = reinterpret_cast<const VstMidiEvent*>(event);
        host->midi_out.push_back({static_cast<uint8_t>(midi->midiData[0]), static_cast<uint8_t>(midi->midiData[1]),
                                  static_cast<uint8_t>(midi->midiData[2]), static_cast<uint8_t>(midi->midiData[3])});
        host->midi_out_delta_frames.push_back(midi->deltaFrames);
      }
      return host->process_events_answer;
    }
    default: return 0;
  }
}

intptr_t dispatch(AEffect* effect, int32_t opcode, int32_t index, intptr_t value, void* ptr, float opt) {
  return effect->dispatcher(effect, opcode, index, value, ptr, opt);
}

std::string param_text(AEffect* effect, int32_t opcode, int32_t index) {
  char text[256];
  std::memset(text, 'X', sizeof(text));
  text[255] = 0;
  dispatch(effect, opcode, index, 0, text);
  return text;
}

void open_and_resume(AEffect* effect, float rate, int32_t block) {
  dispatch(effect, effOpen);
  dispatch(effect, effSetSampleRate, 0, 0, nullptr, rate);
  dispatch(effect, effSetBlockSize, 0, block);
  dispatch(effect, effMainsChanged, 0, 1);
}

void close_instance(AEffect* effect) {
  dispatch(effect, effMainsChanged, 0, 0);
  dispatch(effect, effClose);
}
