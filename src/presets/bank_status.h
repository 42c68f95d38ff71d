#pragma once

namespace plugcore {

// Status codes of the bank file readers and writers (0 is success).
constexpr int kBankOk = 0;
constexpr int kBankCannotOpen = -1002;          // open for reading, or create/replace for writing
constexpr int kBankHeaderWriteFailed = -1004;   // the 8-byte file header was not written
constexpr int kBankHeaderShort = -1005;         // fewer than 8 header bytes could be read
constexpr int kBankSerializeFailed = -1006;     // the bank could not be laid out as a block
constexpr int kBankParseFailed = -1007;         // the bank block is not a valid block
constexpr int kBankBlockWriteShort = -1008;     // fewer than L block bytes were written
constexpr int kBankBlockReadShort = -1009;      // fewer than L block bytes could be read
constexpr int kBankBadMagic = -1010;            // the file does not start with "VLPB"
constexpr int kBankCountMismatch = -1011;       // strict: another number of programs
constexpr int kBankValueCountMismatch = -1012;  // strict: a program with another number of values

// A short sentence for a status code, for messages and tools.
const char* describe_bank_status(int code);

}  // namespace plugcore
