// PNG files of window grabs: written by the snapshot command, read back by
// its tests. Implemented with the platform's PNG library.
#pragma once

#include <string>

#include "cli/editor_parent.h"

namespace plugcore {

// Eight-bit RGB. Throws std::runtime_error when the file cannot be written.
void write_png(const std::string& path, const PixelImage& image);

// Any PNG, converted to 0x00RRGGBB. Throws std::runtime_error.
PixelImage read_png(const std::string& path);

}  // namespace plugcore
