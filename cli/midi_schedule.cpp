#include "cli/midi_schedule.h"

#include <cmath>
#include <cstring>
#include <stdexcept>

#include "midi/settings_vendor_call.h"

namespace plugcore {

MidiSchedule::MidiSchedule(const basic::MidiFileData& file, double sample_rate) {
  events_.reserve(file.events.size());
  for (const auto& source : file.events) {
    Timed timed{};
    timed.frame = static_cast<size_t>(std::floor(source.seconds * sample_rate + 0.5));
    timed.event.type = kVstMidiType;
    timed.event.byteSize = sizeof(VstMidiEvent);
    for (int i = 0; i < 3; ++i) timed.event.midiData[i] = static_cast<char>(source.bytes[i]);
    events_.push_back(timed);
  }
}

size_t MidiSchedule::send_block(HostedPlugin& plugin, size_t first_frame, size_t frames) {
  pointers_.clear();
  while (next_ < events_.size() && events_[next_].frame < first_frame + frames) {
    Timed& timed = events_[next_++];
    timed.event.deltaFrames = static_cast<int32_t>(timed.frame > first_frame ? timed.frame - first_frame : 0);
    pointers_.push_back(reinterpret_cast<VstEvent*>(&timed.event));
  }
  if (pointers_.empty()) return 0;
  // The list header is followed by as many pointers as there are events.
  list_.assign(sizeof(VstEvents) + pointers_.size() * sizeof(VstEvent*), 0);
  auto* list = reinterpret_cast<VstEvents*>(list_.data());
  list->numEvents = static_cast<int32_t>(pointers_.size());
  std::memcpy(list->events, pointers_.data(), pointers_.size() * sizeof(VstEvent*));
  plugin.dispatch(effProcessEvents, 0, 0, list);
  return pointers_.size();
}

void render_with_midi(RenderLoop& loop, MidiSchedule& midi, HostedPlugin& plugin, const float* left,
                      const float* right, size_t frames, size_t block, std::vector<std::vector<float>>& output,
                      const std::function<void(double)>& progress) {
  output.assign(static_cast<size_t>(loop.output_channels()), std::vector<float>(frames));
  std::vector<std::vector<float>> piece;
  for (size_t done = 0; done < frames;) {
    const size_t count = frames - done < block ? frames - done : block;
    midi.send_block(plugin, done, count);
    loop.run(left + done, right != nullptr ? right + done : nullptr, count, piece);
    for (size_t c = 0; c < output.size(); ++c) {
      std::memcpy(output[c].data() + done, piece[c].data(), count * sizeof(float));
    }
    done += count;
    if (progress) progress(static_cast<double>(done) / static_cast<double>(frames));
  }
}

void load_plugin_settings(HostedPlugin& plugin, const std::string& path) {
  if (plugin.dispatch(effVendorSpecific, kSettingsVendorIndex, kSettingsLoadValue, const_cast<char*>(path.c_str())) !=
      1) {
    throw std::runtime_error("the plug-in refused the setting file " + path);
  }
}

}  // namespace plugcore
