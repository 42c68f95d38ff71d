#pragma once

namespace basic {

// Objects that can be written to and read from a flat memory block.
class SerializableInterface {
 public:
  virtual ~SerializableInterface() = default;
  // Reads from a block of `size` bytes and never past it; 0 on success.
  virtual int unserialize(const void* block, int size) = 0;
  // Writes into a block of at least get_serialized_size() bytes; 0 on success.
  virtual int serialize(void* block) const = 0;
  virtual int get_serialized_size() const = 0;
};

}  // namespace basic
