#include "config/mouse_compatibility.h"

#include "config/persistent_key_list.h"

namespace sys {

int read_mouse_compatibility() { return read_persistent_switch(kMouseCompatibilityPath, kMouseCompatibilityName, 0); }

bool write_mouse_compatibility(int mode) {
  return write_persistent_switch(kMouseCompatibilityPath, kMouseCompatibilityName, mode != 0 ? 1 : 0);
}

}  // namespace sys
