// The generated C++ header that tells the editor where each picture sits.
#pragma once

#include <string>
#include <vector>

#include "pictures.h"

namespace skin {

std::string anchors_header(const std::vector<Picture>& pictures);

}  // namespace skin
