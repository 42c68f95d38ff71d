#pragma once

#include <vector>

#include "presets/program_slot.h"
#include "presets/serializable_interface.h"

namespace plugcore {

// An ordered bank of programs. Serialises to a bank block: count N(4),
// record size R(4), then N records of R bytes each, R taken from program 0.
class BankManager : public basic::SerializableInterface {
 public:
  static constexpr int kHeaderSize = 8;

  void resize(int count);
  int get_nbr_programs() const;
  // Throw std::runtime_error for an index outside the bank.
  void set_program(int index, const ProgramSlot& slot);
  void get_program(int index, ProgramSlot& slot) const;
  ProgramSlot& use_program(int index);
  const ProgramSlot& use_program(int index) const;

  // Refuses (nonzero, bank unchanged) a block whose records reach past
  // `size`, whose record size cannot hold a record header, or one of whose
  // records overflows its R bytes.
  int unserialize(const void* block, int size) override;
  // Nonzero when some program's record size differs from program 0's: the
  // block has one record size for all.
  int serialize(void* block) const override;
  int get_serialized_size() const override;

 private:
  void check_index(int index, const char* operation) const;

  std::vector<ProgramSlot> programs_;
};

}  // namespace plugcore
