#include "presets/bank_status.h"

namespace plugcore {

namespace {

struct StatusText {
  int code;
  const char* text;
};

const StatusText kStatusTexts[] = {
    {kBankOk, "No error."},
    {kBankCannotOpen, "The file cannot be opened."},
    {kBankHeaderWriteFailed, "The file header could not be written."},
    {kBankHeaderShort, "The file is too short to hold a bank header."},
    {kBankSerializeFailed, "The bank could not be laid out for writing."},
    {kBankParseFailed, "The bank data is damaged or inconsistent."},
    {kBankBlockWriteShort, "The bank data could not be written completely."},
    {kBankBlockReadShort, "The file ends before the bank data it announces."},
    {kBankBadMagic, "The file is not a preset bank."},
    {kBankCountMismatch, "The bank holds another number of programs."},
    {kBankValueCountMismatch, "A program of the bank holds another number of parameters."},
};

}  // namespace

const char* describe_bank_status(int code) {
  for (const StatusText& entry : kStatusTexts) {
    if (entry.code == code) {
      return entry.text;
    }
  }
  return "Unknown error.";
}

}  // namespace plugcore
