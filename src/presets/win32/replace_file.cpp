#include "presets/replace_file.h"

#include <windows.h>

namespace plugcore {

// rename() refuses an existing target on this system; MoveFileEx replaces it.
bool replace_file(const std::string& from, const std::string& to) {
  return MoveFileExA(from.c_str(), to.c_str(), MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH) != 0;
}

}  // namespace plugcore
