// Fuzz target for the three preset readers. Whatever a reader accepts must
// lay out again, and reading that layout back must give the same bytes.
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <vector>

#include "presets/bank_file.h"
#include "presets/bank_manager.h"
#include "presets/program_slot.h"

namespace {

// serialize -> unserialize -> serialize must reproduce the first layout.
template <typename T>
void check_round_trip(const T& accepted) {
  const int size = accepted.get_serialized_size();
  if (size < 0) {
    return;  // too large to lay out: refused by the writer, nothing to compare
  }
  std::vector<uint8_t> first(static_cast<size_t>(size), 0);
  if (accepted.serialize(first.data()) != 0) {
    return;  // the writer refuses shapes the reader tolerates (records of mixed sizes)
  }
  T again;
  if (again.unserialize(first.data(), size) != 0) {
    std::abort();
  }
  if (again.get_serialized_size() != size) {
    std::abort();
  }
  std::vector<uint8_t> second(static_cast<size_t>(size), 0);
  if (again.serialize(second.data()) != 0 || std::memcmp(first.data(), second.data(), first.size()) != 0) {
    std::abort();
  }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  if (size > (1u << 20)) {
    return 0;
  }
  // A copy of exactly `size` bytes, so any read past the end is caught.
  std::vector<uint8_t> input(data, data + size);
  const int n = static_cast<int>(size);
  const uint8_t* block = input.empty() ? nullptr : input.data();

  plugcore::ProgramSlot slot;
  if (slot.unserialize(block, n) == 0) {
    check_round_trip(slot);
  }

  plugcore::BankManager bank;
  if (bank.unserialize(block, n) == 0) {
    check_round_trip(bank);
  }

  plugcore::BankManager target;
  target.resize(8);
  if (plugcore::load_bank_mem(block, n, target, false) == 0) {
    check_round_trip(target);
  }
  return 0;
}
