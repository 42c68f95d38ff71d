// The events of a MIDI file laid out on the sample timeline of a render, and
// handed to the plug-in block by block through effProcessEvents.
#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <vector>

#include "cli/hosted_plugin.h"
#include "cli/midi_file.h"
#include "cli/render_loop.h"

namespace plugcore {

class MidiSchedule {
 public:
  MidiSchedule(const basic::MidiFileData& file, double sample_rate);

  // Sends every event of [first_frame, first_frame + frames) with its offset
  // in the block; returns how many were sent.
  size_t send_block(HostedPlugin& plugin, size_t first_frame, size_t frames);
  size_t remaining() const { return events_.size() - next_; }

 private:
  struct Timed {
    size_t frame;
    VstMidiEvent event;
  };
  std::vector<Timed> events_;
  size_t next_ = 0;
  std::vector<VstEvent*> pointers_;
  std::vector<unsigned char> list_;
};

// The render loop one block at a time, each block preceded by its MIDI events.
void render_with_midi(RenderLoop& loop, MidiSchedule& midi, HostedPlugin& plugin, const float* left,
                      const float* right, size_t frames, size_t block, std::vector<std::vector<float>>& output,
                      const std::function<void(double)>& progress);

// Asks the plug-in to load a setting file; throws std::runtime_error when it refuses.
void load_plugin_settings(HostedPlugin& plugin, const std::string& path);

}  // namespace plugcore
