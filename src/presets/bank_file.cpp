#include "presets/bank_file.h"

#include <cstdint>
#include <cstdio>
#include <cstring>
#include <vector>

#include "presets/bank_status.h"
#include "presets/big_endian.h"
#include "presets/replace_file.h"

namespace plugcore {

namespace {

const char kMagic[4] = {'V', 'L', 'P', 'B'};
constexpr int kFileHeaderSize = 8;

// Closes the file on every path out of a function.
class FileCloser {
 public:
  explicit FileCloser(std::FILE* file) : file_(file) {}
  FileCloser(const FileCloser&) = delete;
  FileCloser& operator=(const FileCloser&) = delete;
  ~FileCloser() {
    if (file_ != nullptr) {
      std::fclose(file_);
    }
  }
  // Closes now and reports whether buffered bytes reached the disk.
  bool close() {
    std::FILE* file = file_;
    file_ = nullptr;
    return file != nullptr && std::fclose(file) == 0;
  }

 private:
  std::FILE* file_;
};

int parse_bank_block(const uint8_t* block, int size, BankManager& target, bool strict) {
  BankManager loaded;
  if (loaded.unserialize(block, size) != 0) {
    return kBankParseFailed;
  }
  if (strict) {
    if (loaded.get_nbr_programs() != target.get_nbr_programs()) {
      return kBankCountMismatch;
    }
    for (int i = 0; i < loaded.get_nbr_programs(); ++i) {
      if (loaded.use_program(i).get_nbr_values() != target.use_program(i).get_nbr_values()) {
        return kBankValueCountMismatch;
      }
    }
  }
  target = loaded;
  return kBankOk;
}

// Writes header and block to an open file; the file's status codes.
int write_bank(std::FILE* file, const BankManager& bank) {
  const int length = bank.get_serialized_size();
  uint8_t header[kFileHeaderSize];
  std::memcpy(header, kMagic, sizeof(kMagic));
  write_be32(header + 4, static_cast<uint32_t>(length < 0 ? 0 : length));
  if (std::fwrite(header, 1, sizeof(header), file) != sizeof(header)) {
    return kBankHeaderWriteFailed;
  }
  if (length < 0) {
    return kBankSerializeFailed;
  }
  std::vector<uint8_t> block(static_cast<size_t>(length), 0);
  if (bank.serialize(block.data()) != 0) {
    return kBankSerializeFailed;
  }
  if (std::fwrite(block.data(), 1, block.size(), file) != block.size()) {
    return kBankBlockWriteShort;
  }
  return kBankOk;
}

}  // namespace

std::string bank_temp_path(const std::string& path) { return path + ".tmp"; }

int load_bank_mem(const void* image, int size, BankManager& bank, bool strict) {
  if (image == nullptr || size < kFileHeaderSize) {
    return kBankHeaderShort;
  }
  const uint8_t* p = static_cast<const uint8_t*>(image);
  if (std::memcmp(p, kMagic, sizeof(kMagic)) != 0) {
    return kBankBadMagic;
  }
  // The length field is not consulted: the image's own size bounds the block.
  return parse_bank_block(p + kFileHeaderSize, size - kFileHeaderSize, bank, strict);
}

int load_bank_file(const std::string& path, BankManager& bank, bool strict) {
  std::FILE* file = std::fopen(path.c_str(), "rb");
  if (file == nullptr) {
    return kBankCannotOpen;
  }
  FileCloser closer(file);

  uint8_t header[kFileHeaderSize];
  if (std::fread(header, 1, sizeof(header), file) != sizeof(header)) {
    return kBankHeaderShort;
  }
  if (std::memcmp(header, kMagic, sizeof(kMagic)) != 0) {
    return kBankBadMagic;
  }
  const uint32_t length = read_be32(header + 4);
  if (length > static_cast<uint32_t>(INT32_MAX)) {
    return kBankParseFailed;
  }

  // Read in pieces so a length field that lies costs no more memory than the
  // file really holds.
  std::vector<uint8_t> block;
  const size_t piece = 65536;
  while (block.size() < length) {
    size_t want = length - block.size();
    if (want > piece) {
      want = piece;
    }
    size_t old_size = block.size();
    block.resize(old_size + want);
    size_t got = std::fread(block.data() + old_size, 1, want, file);
    if (got != want) {
      return kBankBlockReadShort;
    }
  }
  return parse_bank_block(block.data(), static_cast<int>(block.size()), bank, strict);
}

int save_bank_file(const std::string& path, const BankManager& bank) {
  const std::string temp_path = bank_temp_path(path);
  std::FILE* file = std::fopen(temp_path.c_str(), "wb");
  if (file == nullptr) {
    return kBankCannotOpen;
  }
  FileCloser closer(file);
  int status = write_bank(file, bank);
  if (status == kBankOk && !closer.close()) {
    status = kBankBlockWriteShort;
  }
  if (status == kBankOk && !replace_file(temp_path, path)) {
    status = kBankCannotOpen;
  }
  if (status != kBankOk) {
    closer.close();
    std::remove(temp_path.c_str());
  }
  return status;
}

}  // namespace plugcore
