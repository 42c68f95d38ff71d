#pragma once

#include <string>
#include <vector>

namespace plugcore {

// A named group of audio pins ("Stereo In" with its left and right pins).
struct PinGroup {
  std::string name;
  std::vector<std::string> pins;
};

}  // namespace plugcore
