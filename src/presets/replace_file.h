#pragma once

#include <string>

namespace plugcore {

// Moves `from` onto `to`, replacing an existing `to` in one step; true on
// success. Each platform folder provides it.
bool replace_file(const std::string& from, const std::string& to);

}  // namespace plugcore
