#pragma once

#include "presets/bank_manager.h"

namespace plugcore {

constexpr int kNbrFactoryPrograms = 8;
constexpr int kNbrFactoryValues = 40;

// Name of factory program `program` (0..7).
const char* factory_program_name(int program);
// Normalised value of parameter `index` (0..39) in factory program `program`.
float factory_program_value(int program, int index);

// Fills `bank` with the 8 factory programs: 40 values each, no extra bytes, tag 0.
void make_factory_bank(BankManager& bank);

}  // namespace plugcore
