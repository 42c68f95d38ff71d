// Reading a preset bank file far enough to hand its bank block to a plug-in:
// the 8-byte header ("VLPB", big-endian block length) and the block itself.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace plugcore {

enum : int {
  kBankOk = 0,
  kBankCannotOpen = -1002,
  kBankShortHeader = -1005,
  kBankRefusedBlock = -1007,
  kBankShortBlock = -1009,
  kBankBadMagic = -1010,
};

// Fills block with the L bytes after the header. Returns 0 or one of the
// status codes above.
int read_bank_file_block(const std::string& path, std::vector<uint8_t>& block);

// The status in words, e.g. "the file cannot be opened".
std::string bank_status_text(int status);

}  // namespace plugcore
