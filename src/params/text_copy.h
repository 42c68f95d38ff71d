#pragma once

namespace plugcore {

// Bounded copy for every text handed to the host or the editor: at most
// capacity - 1 characters, always terminated; nothing is written when the
// capacity is not positive; a null source reads as the empty text.
void copy_text(char* dest, const char* src, int capacity);

}  // namespace plugcore
