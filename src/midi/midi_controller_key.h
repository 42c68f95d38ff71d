#pragma once

#include <cstdint>

namespace plugcore {

// A controller key: the high 16 bits name the kind (a CC number, or the
// selector numbers 99 for NRPN and 101 for RPN), the low 16 bits the RPN or
// NRPN number (0 for a CC).
enum : int32_t { kMidiKindNrpn = 99, kMidiKindRpn = 101 };

inline int32_t make_midi_key(int kind, int number) {
  const bool numbered = kind == kMidiKindNrpn || kind == kMidiKindRpn;
  return static_cast<int32_t>(static_cast<uint32_t>(kind) << 16) + (numbered ? number : 0);
}
inline int midi_key_kind(int32_t key) { return static_cast<int>(static_cast<uint32_t>(key) >> 16); }
inline int midi_key_number(int32_t key) { return static_cast<int>(key & 0xFFFF); }

}  // namespace plugcore
