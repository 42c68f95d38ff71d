#include "params/text_copy.h"

namespace plugcore {

void copy_text(char* dest, const char* src, int capacity) {
  if (dest == nullptr || capacity <= 0) {
    return;
  }
  int count = 0;
  if (src != nullptr) {
    while (count < capacity - 1 && src[count] != '\0') {
      dest[count] = src[count];
      ++count;
    }
  }
  dest[count] = '\0';
  // The last byte is always a terminator, whatever the copy stopped on.
  dest[capacity - 1] = '\0';
}

}  // namespace plugcore
