#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

namespace sys {

// Receives the short messages of an open system input on the driver's thread.
class MidiInputSinkInterface {
 public:
  virtual ~MidiInputSinkInterface() = default;
  // message: status in bits 0-7, data 1 in bits 8-15, data 2 in bits 16-23.
  virtual void on_midi_short(uint32_t message, uint32_t time_stamp) = 0;
};

// The operating system's MIDI ports, one input and one output open at a time.
// Every operation answers 0 or -1.
class MidiPortDriverInterface {
 public:
  virtual ~MidiPortDriverInterface() = default;
  virtual int list_inputs(std::vector<std::string>& names) = 0;
  virtual int list_outputs(std::vector<std::string>& names) = 0;
  // Messages reach sink until close_input returns; close_input waits for a
  // callback in progress.
  virtual int open_input(int port, MidiInputSinkInterface* sink) = 0;
  virtual int close_input() = 0;
  virtual int open_output(int port) = 0;
  virtual int send_short(uint32_t message) = 0;
  virtual int close_output() = 0;
};

// The platform's driver (the multimedia MIDI functions on Windows, the
// sequencer elsewhere); a system without MIDI gives a driver that lists no ports.
std::unique_ptr<MidiPortDriverInterface> make_system_midi_driver();

}  // namespace sys
