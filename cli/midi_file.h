// Standard MIDI File reading (formats 0 and 1): the channel messages of all
// tracks in time order, with their times in seconds from the tempo map.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

namespace basic {

struct MidiFileEvent {
  double seconds = 0.0;
  uint8_t bytes[3] = {0, 0, 0};
};

struct MidiFileData {
  int format = 0;
  int tracks = 0;
  int division = 0;
  std::vector<MidiFileEvent> events;  // ascending time; ties keep track, then file order
};

// Throws std::runtime_error with a one-line reason for anything that is not
// a well-formed format 0 or 1 file; reading never runs past the data.
MidiFileData parse_midi_file(const uint8_t* data, size_t size);
MidiFileData read_midi_file(const std::string& path);

}  // namespace basic
