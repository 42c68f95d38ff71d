#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>

#include "guikit/pic_data_interface.h"

namespace guikit {

// Turns "APIC" resources into picture objects. Opaque pictures (kind 0) and pictures
// with opacity (kind 1) of 8 or 24 bits are read; anything else, a missing resource
// or data that fails the header checks gives no picture.
class PicDataFactory {
 public:
  virtual ~PicDataFactory() = default;

  // The module's resource of type "APIC" with this name (any case).
  virtual std::unique_ptr<PicDataInterface> create_picture(const char* name) const;

  // The same reading from bytes in memory, which must outlive the picture.
  static std::unique_ptr<PicDataInterface> create_from_memory(const uint8_t* data, size_t size);

  static PicDataFactory& instance();
};

}  // namespace guikit
