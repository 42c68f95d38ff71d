#pragma once

#include <string>
#include <vector>

namespace plugcore {

class MidiInInterface;
class MidiOutInterface;

// A source of MIDI devices (the host, the system's ports). Global indices
// number the devices of all components in one list per direction; a
// component learns where its devices start when it lists them. A component
// owns the devices it creates; close_* closes and forgets the open one.
class MidiDevSelCompInterface {
 public:
  virtual ~MidiDevSelCompInterface() = default;
  virtual int init() = 0;
  virtual int list_inputs(int first_index, std::vector<std::string>& names) = 0;
  virtual int list_outputs(int first_index, std::vector<std::string>& names) = 0;
  virtual int open_input(int index, MidiInInterface*& device) = 0;
  virtual int open_output(int index, MidiOutInterface*& device) = 0;
  virtual int close_input() = 0;
  virtual int close_output() = 0;
};

}  // namespace plugcore
