#pragma once

#include <cstdint>
#include <cstring>
#include <string>
#include <vector>

#include "presets/bank_manager.h"
#include "presets/program_slot.h"

// Builds big-endian test blocks by hand, independently of the writers.
class ByteBuilder {
 public:
  ByteBuilder& u32(uint32_t v) {
    for (int shift = 24; shift >= 0; shift -= 8) bytes.push_back(static_cast<uint8_t>(v >> shift));
    return *this;
  }
  ByteBuilder& u16(uint16_t v) {
    bytes.push_back(static_cast<uint8_t>(v >> 8));
    bytes.push_back(static_cast<uint8_t>(v));
    return *this;
  }
  ByteBuilder& f32(float f) {
    uint32_t bits;
    std::memcpy(&bits, &f, sizeof(bits));
    return u32(bits);
  }
  ByteBuilder& text(const std::string& s, size_t field) {
    for (size_t i = 0; i < field; ++i) bytes.push_back(i < s.size() ? static_cast<uint8_t>(s[i]) : 0);
    return *this;
  }
  ByteBuilder& raw(const std::vector<uint8_t>& more) {
    bytes.insert(bytes.end(), more.begin(), more.end());
    return *this;
  }
  int size() const { return static_cast<int>(bytes.size()); }
  std::vector<uint8_t> bytes;
};

inline uint32_t float_bits(float f) {
  uint32_t bits;
  std::memcpy(&bits, &f, sizeof(bits));
  return bits;
}

// Serialised image of anything serialisable: compares whole objects bytewise.
template <typename T>
std::vector<uint8_t> image_of(const T& object) {
  const int size = object.get_serialized_size();
  std::vector<uint8_t> bytes(size > 0 ? static_cast<size_t>(size) : 0, 0xAA);
  if (object.serialize(bytes.data()) != 0) {
    bytes.clear();
  }
  return bytes;
}

// Every field of two slots, values compared by their bits.
inline bool same_slot(const plugcore::ProgramSlot& a, const plugcore::ProgramSlot& b) {
  if (a.get_name() != b.get_name() || a.get_tag() != b.get_tag() || a.get_nbr_values() != b.get_nbr_values() ||
      a.get_extra_size() != b.get_extra_size()) {
    return false;
  }
  for (int i = 0; i < a.get_nbr_values(); ++i) {
    if (float_bits(a.get_value(i)) != float_bits(b.get_value(i))) return false;
  }
  return a.get_extra_size() == 0 ||
         std::memcmp(a.use_extra_data(), b.use_extra_data(), static_cast<size_t>(a.get_extra_size())) == 0;
}

inline bool same_bank(const plugcore::BankManager& a, const plugcore::BankManager& b) {
  if (a.get_nbr_programs() != b.get_nbr_programs()) return false;
  for (int i = 0; i < a.get_nbr_programs(); ++i) {
    if (!same_slot(a.use_program(i), b.use_program(i))) return false;
  }
  return true;
}

// A slot with distinct, recognisable content derived from `seed`.
inline plugcore::ProgramSlot make_slot(int seed, int nbr_values = 40, int extra = 0) {
  plugcore::ProgramSlot slot;
  slot.set_name("Program " + std::to_string(seed));
  slot.set_tag(0x1000u * static_cast<uint32_t>(seed) + 7u);
  slot.set_nbr_values(nbr_values);
  for (int i = 0; i < nbr_values; ++i) {
    slot.set_value(i, static_cast<float>((seed * 41 + i) % 97) / 96.0f);
  }
  slot.set_extra_size(extra);
  for (int i = 0; i < extra; ++i) {
    slot.use_extra_data()[i] = static_cast<uint8_t>(seed * 13 + i);
  }
  return slot;
}
