// Fuzz target for the Standard MIDI File reader: any input is read or refused
// with an error; what is read is in time order and holds only channel messages.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <stdexcept>

#include "cli/midi_file.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  try {
    const basic::MidiFileData file = basic::parse_midi_file(data, size);
    double last = 0.0;
    for (const auto& event : file.events) {
      if (event.bytes[0] < 0x80 || event.bytes[0] >= 0xF0 || event.bytes[1] >= 0x80 || event.bytes[2] >= 0x80) {
        std::abort();
      }
      if (!(event.seconds >= last)) std::abort();
      last = event.seconds;
    }
  } catch (const std::runtime_error&) {
  }
  return 0;
}
