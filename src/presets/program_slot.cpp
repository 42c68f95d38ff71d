#include "presets/program_slot.h"

#include <cstring>
#include <stdexcept>

#include "presets/big_endian.h"

namespace plugcore {

void ProgramSlot::set_nbr_values(int count) { values_.resize(count > 0 ? static_cast<size_t>(count) : 0, 0.0f); }

int ProgramSlot::get_nbr_values() const { return static_cast<int>(values_.size()); }

void ProgramSlot::set_value(int index, float value) {
  if (index < 0 || index >= get_nbr_values()) {
    throw std::runtime_error("plugcore::ProgramSlot::set_value() : Invalid index.");
  }
  values_[static_cast<size_t>(index)] = value;
}

float ProgramSlot::get_value(int index) const {
  if (index < 0 || index >= get_nbr_values()) {
    throw std::runtime_error("plugcore::ProgramSlot::get_value() : Invalid index.");
  }
  return values_[static_cast<size_t>(index)];
}

void ProgramSlot::set_name(const std::string& name) { name_ = name; }

const std::string& ProgramSlot::get_name() const { return name_; }

void ProgramSlot::set_extra_size(int size) { extra_.resize(size > 0 ? static_cast<size_t>(size) : 0, 0); }

int ProgramSlot::get_extra_size() const { return static_cast<int>(extra_.size()); }

uint8_t* ProgramSlot::use_extra_data() { return extra_.data(); }

const uint8_t* ProgramSlot::use_extra_data() const { return extra_.data(); }

void ProgramSlot::set_tag(uint32_t tag) { tag_ = tag; }

uint32_t ProgramSlot::get_tag() const { return tag_; }

int ProgramSlot::unserialize(const void* block, int size) {
  if (block == nullptr || size < kHeaderSize) {
    return -1;
  }
  const uint8_t* p = static_cast<const uint8_t*>(block);
  const uint32_t tag = read_be32(p);
  const uint32_t name_size = read_be16(p + 4);
  const uint32_t nbr_values = read_be16(p + 6);
  const uint32_t extra_size = read_be32(p + 8);

  // 64-bit sums: E alone can be near 4 GiB.
  const uint64_t values_at = kHeaderSize + static_cast<uint64_t>(name_size);
  const uint64_t extra_at = values_at + 4u * static_cast<uint64_t>(nbr_values);
  const uint64_t end = extra_at + extra_size;
  if (end > static_cast<uint64_t>(size)) {
    return -1;
  }

  // The name ends at its first zero, and never beyond its own field.
  const char* name_bytes = reinterpret_cast<const char*>(p + kHeaderSize);
  size_t name_length = 0;
  while (name_length < name_size && name_bytes[name_length] != '\0') {
    ++name_length;
  }

  std::vector<float> values(nbr_values);
  for (uint32_t i = 0; i < nbr_values; ++i) {
    // Through the bits, so every float (NaN payloads included) survives unchanged.
    const uint32_t bits = read_be32(p + values_at + 4u * i);
    std::memcpy(&values[i], &bits, sizeof(bits));
  }
  std::vector<uint8_t> extra(p + extra_at, p + end);

  tag_ = tag;
  name_.assign(name_bytes, name_length);
  values_.swap(values);
  extra_.swap(extra);
  return 0;
}

int ProgramSlot::serialize(void* block) const {
  if (block == nullptr || values_.size() > 0xFFFFu || get_serialized_size() < 0) {
    return -1;
  }
  uint8_t* p = static_cast<uint8_t*>(block);
  write_be32(p, tag_);
  write_be16(p + 4, static_cast<uint16_t>(kNameFieldSize));
  write_be16(p + 6, static_cast<uint16_t>(values_.size()));
  write_be32(p + 8, static_cast<uint32_t>(extra_.size()));

  uint8_t* name_field = p + kHeaderSize;
  std::memset(name_field, 0, kNameFieldSize);
  size_t name_length = name_.size() < kNameFieldSize - 1 ? name_.size() : kNameFieldSize - 1;
  std::memcpy(name_field, name_.data(), name_length);

  uint8_t* value_field = name_field + kNameFieldSize;
  for (size_t i = 0; i < values_.size(); ++i) {
    uint32_t bits = 0;
    std::memcpy(&bits, &values_[i], sizeof(bits));
    write_be32(value_field + 4 * i, bits);
  }
  if (!extra_.empty()) {
    std::memcpy(value_field + 4 * values_.size(), extra_.data(), extra_.size());
  }
  return 0;
}

int ProgramSlot::get_serialized_size() const {
  const uint64_t size = kHeaderSize + kNameFieldSize + 4u * static_cast<uint64_t>(values_.size()) + extra_.size();
  // A slot too large for an int-sized record cannot be laid out at all.
  return size > static_cast<uint64_t>(INT32_MAX) ? -1 : static_cast<int>(size);
}

}  // namespace plugcore
