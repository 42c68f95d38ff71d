#include "cli/bank_file_check.h"

#include <cstdio>
#include <cstring>

namespace plugcore {
namespace {

struct StatusText {
  int status;
  const char* text;
};

const StatusText kStatusTexts[] = {
    {kBankOk, "success"},
    {kBankCannotOpen, "the file cannot be opened"},
    {kBankShortHeader, "the file is shorter than its 8-byte header"},
    {kBankRefusedBlock, "the plug-in refused the bank block"},
    {kBankShortBlock, "the file holds fewer bytes than its header promises"},
    {kBankBadMagic, "the file does not start with \"VLPB\""},
};

// A bank block longer than this is not a bank; refusing it avoids a huge
// allocation from a corrupt length field.
constexpr uint32_t kMaxBlockLength = 64u << 20;

}  // namespace

int read_bank_file_block(const std::string& path, std::vector<uint8_t>& block) {
  std::FILE* file = std::fopen(path.c_str(), "rb");
  if (file == nullptr) {
    return kBankCannotOpen;
  }
  uint8_t header[8];
  int status = kBankOk;
  if (std::fread(header, 1, sizeof(header), file) != sizeof(header)) {
    status = kBankShortHeader;
  } else if (std::memcmp(header, "VLPB", 4) != 0) {
    status = kBankBadMagic;
  } else {
    const uint32_t length = (uint32_t{header[4]} << 24) | (uint32_t{header[5]} << 16) |
                            (uint32_t{header[6]} << 8) | uint32_t{header[7]};
    if (length > kMaxBlockLength) {
      status = kBankShortBlock;
    } else {
      block.assign(length, 0);
      if (std::fread(block.data(), 1, length, file) != length) {
        status = kBankShortBlock;
      }
    }
  }
  std::fclose(file);
  return status;
}

std::string bank_status_text(int status) {
  for (const StatusText& entry : kStatusTexts) {
    if (entry.status == status) {
      return entry.text;
    }
  }
  return "unknown bank status";
}

}  // namespace plugcore
