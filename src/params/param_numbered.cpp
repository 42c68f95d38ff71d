#include "params/param_numbered.h"

#include <cstdio>
#include <cstring>

namespace plugcore {

namespace {

// Appends a piece at the end of the text, keeping room for the terminator;
// returns false once no character of room is left.
bool append_bounded(char* text, int capacity, const char* piece) {
  int length = static_cast<int>(std::strlen(text));
  int room = capacity - 1 - length;
  if (room < 1) {
    return false;
  }
  int i = 0;
  while (i < room && piece[i] != '\0') {
    text[length + i] = piece[i];
    ++i;
  }
  text[length + i] = '\0';
  return true;
}

}  // namespace

void ParamNumbered::init(double default_value, int priority, int number) {
  NormalizedParamInterface::init(default_value, priority);
  number_ = number;
}

void ParamNumbered::get_name(char* text, int capacity) const {
  if (text == nullptr || capacity <= 0) {
    return;
  }
  text[0] = '\0';
  // The pieces are short; a fixed scratch buffer bounds each one.
  char piece[64];
  get_name_prefix(piece, static_cast<int>(sizeof(piece)));
  if (!append_bounded(text, capacity, piece)) {
    return;
  }
  std::snprintf(piece, sizeof(piece), "%d", number_ + 1);
  if (!append_bounded(text, capacity, piece)) {
    return;
  }
  get_name_suffix(piece, static_cast<int>(sizeof(piece)));
  append_bounded(text, capacity, piece);
}

}  // namespace plugcore
