#include "presets/bank_manager.h"

#include <cstdint>
#include <stdexcept>
#include <string>

#include "presets/big_endian.h"

namespace plugcore {

void BankManager::resize(int count) { programs_.resize(count > 0 ? static_cast<size_t>(count) : 0); }

int BankManager::get_nbr_programs() const { return static_cast<int>(programs_.size()); }

void BankManager::check_index(int index, const char* operation) const {
  if (index < 0 || index >= get_nbr_programs()) {
    throw std::runtime_error(std::string("plugcore::BankManager::") + operation + "() : Invalid index.");
  }
}

void BankManager::set_program(int index, const ProgramSlot& slot) {
  check_index(index, "set_program");
  programs_[static_cast<size_t>(index)] = slot;
}

void BankManager::get_program(int index, ProgramSlot& slot) const {
  check_index(index, "get_program");
  slot = programs_[static_cast<size_t>(index)];
}

ProgramSlot& BankManager::use_program(int index) {
  check_index(index, "use_program");
  return programs_[static_cast<size_t>(index)];
}

const ProgramSlot& BankManager::use_program(int index) const {
  check_index(index, "use_program");
  return programs_[static_cast<size_t>(index)];
}

int BankManager::unserialize(const void* block, int size) {
  if (block == nullptr || size < kHeaderSize) {
    return -1;
  }
  const uint8_t* p = static_cast<const uint8_t*>(block);
  const uint32_t count = read_be32(p);
  const uint32_t record_size = read_be32(p + 4);

  std::vector<ProgramSlot> programs;
  if (count > 0) {
    if (record_size < static_cast<uint32_t>(ProgramSlot::kHeaderSize)) {
      return -1;
    }
    // 64-bit product: N and R are both 32-bit fields from outside.
    const uint64_t end = kHeaderSize + static_cast<uint64_t>(count) * record_size;
    if (end > static_cast<uint64_t>(size)) {
      return -1;
    }
    // Bounded by size / 12 now, so the count fits an int and the allocation is sane.
    programs.resize(count);
    for (uint32_t i = 0; i < count; ++i) {
      const uint8_t* record = p + kHeaderSize + static_cast<uint64_t>(i) * record_size;
      if (programs[i].unserialize(record, static_cast<int>(record_size)) != 0) {
        return -1;
      }
    }
  }
  programs_.swap(programs);
  return 0;
}

int BankManager::serialize(void* block) const {
  if (block == nullptr) {
    return -1;
  }
  const int count = get_nbr_programs();
  const int record_size = count > 0 ? programs_[0].get_serialized_size() : 0;
  if (get_serialized_size() < 0) {
    return -1;
  }
  for (const ProgramSlot& program : programs_) {
    if (program.get_serialized_size() != record_size) {
      return -1;
    }
  }
  uint8_t* p = static_cast<uint8_t*>(block);
  write_be32(p, static_cast<uint32_t>(count));
  write_be32(p + 4, static_cast<uint32_t>(record_size));
  for (int i = 0; i < count; ++i) {
    uint8_t* record = p + kHeaderSize + static_cast<size_t>(i) * static_cast<size_t>(record_size);
    if (programs_[static_cast<size_t>(i)].serialize(record) != 0) {
      return -1;
    }
  }
  return 0;
}

int BankManager::get_serialized_size() const {
  const int count = get_nbr_programs();
  const int record_size = count > 0 ? programs_[0].get_serialized_size() : 0;
  if (record_size < 0) {
    return -1;
  }
  const uint64_t size = kHeaderSize + static_cast<uint64_t>(count) * static_cast<uint64_t>(record_size);
  // -1 when the block would not fit an int (a bank of absurd size).
  return size > static_cast<uint64_t>(INT32_MAX) ? -1 : static_cast<int>(size);
}

}  // namespace plugcore
