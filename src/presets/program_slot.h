#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "presets/serializable_interface.h"

namespace plugcore {

// One program: a normalised value per parameter, opaque extra bytes, a name
// and a tag. Serialises to one big-endian program record:
// tag(4) F(2) V(2) E(4) name(F) values(4V) extra(E).
class ProgramSlot : public basic::SerializableInterface {
 public:
  static constexpr int kHeaderSize = 12;
  static constexpr int kNameFieldSize = 64;  // the writer's F; 63 characters and a zero

  ProgramSlot() = default;
  ProgramSlot(const ProgramSlot&) = default;
  ProgramSlot& operator=(const ProgramSlot&) = default;

  void set_nbr_values(int count);
  int get_nbr_values() const;
  // Throw std::runtime_error for an index outside the values.
  void set_value(int index, float value);
  float get_value(int index) const;

  void set_name(const std::string& name);
  const std::string& get_name() const;

  void set_extra_size(int size);
  int get_extra_size() const;
  uint8_t* use_extra_data();
  const uint8_t* use_extra_data() const;

  void set_tag(uint32_t tag);
  uint32_t get_tag() const;

  // Refuses (nonzero, slot unchanged) a block below the 12-byte header or a
  // record whose name, values or extra bytes reach past `size`.
  int unserialize(const void* block, int size) override;
  // Nonzero when the record cannot hold the slot (more than 65535 values).
  int serialize(void* block) const override;
  int get_serialized_size() const override;

 private:
  std::vector<float> values_;
  std::vector<uint8_t> extra_;
  std::string name_ = "Default";
  uint32_t tag_ = 0;
};

}  // namespace plugcore
