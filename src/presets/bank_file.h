#pragma once

#include <string>

#include "presets/bank_manager.h"

namespace plugcore {

// Bank files (and the module's bank resources): "VLPB", block length L
// (big-endian 32-bit), then the bank block. Status codes: presets/bank_status.h.

// Reads a bank file into `bank`. With `strict` the file must hold as many
// programs as `bank`, each with as many values; on any error `bank` is unchanged.
int load_bank_file(const std::string& path, BankManager& bank, bool strict);

// The same from a file image of `size` bytes in memory; never reads past it.
int load_bank_mem(const void* image, int size, BankManager& bank, bool strict);

// Writes `bank` to a temporary file beside `path`, then moves it over
// `path`, so a failed save leaves an existing file as it was.
int save_bank_file(const std::string& path, const BankManager& bank);

// The temporary file a save of `path` writes first.
std::string bank_temp_path(const std::string& path);

}  // namespace plugcore
