#pragma once

#include <cstdint>

namespace plugcore {

struct MidiChannelState;

// Controller decoding: the RPN/NRPN number selectors, data entry, and the
// key and 14-bit value that every other controller stands for.
class MidiInCcMixin {
 public:
  // Decodes controller n with value v (both 7-bit) on the channel. Answers
  // true with (key, value) for the controller step; false for the four number
  // selectors, which carry no key of their own. nrpn_compatibility 1 is the
  // standard byte order (CC 99 / CC 101 carry the high bits).
  static bool decode_controller(MidiChannelState& state, int n, int v, int nrpn_compatibility, int32_t& key,
                                int& value);
};

}  // namespace plugcore
