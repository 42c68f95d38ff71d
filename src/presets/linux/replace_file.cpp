#include "presets/replace_file.h"

#include <cstdio>

namespace plugcore {

// rename() replaces an existing target atomically here.
bool replace_file(const std::string& from, const std::string& to) { return std::rename(from.c_str(), to.c_str()) == 0; }

}  // namespace plugcore
