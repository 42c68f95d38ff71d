#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>

#include "guikit/font_interface.h"

namespace guikit {

// Turns "APIC" resources into fonts: kind 2 with 0 bits is a unicolour font, kind 1
// with 8 bits a multicolour one. Anything else, a missing resource, a picture
// without its marker row or data that fails the header checks gives no font.
class FontFactory {
 public:
  virtual ~FontFactory() = default;

  // The module's resource of type "APIC" with this name (any case).
  virtual std::unique_ptr<FontInterface> create_font(const char* name) const;

  // The same reading from bytes in memory, which must outlive the font.
  static std::unique_ptr<FontInterface> create_from_memory(const uint8_t* data, size_t size);

  static FontFactory& instance();
};

}  // namespace guikit
