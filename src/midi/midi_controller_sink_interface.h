#pragma once

#include <cstdint>

namespace plugcore {

// Where an input hands every controller key with its 14-bit value (the MIDI
// manager: learning, lookup, parameter write).
class MidiControllerSinkInterface {
 public:
  virtual ~MidiControllerSinkInterface() = default;
  virtual void controller_step(int32_t key, int value) = 0;
  virtual int get_nrpn_compatibility() const = 0;
};

}  // namespace plugcore
