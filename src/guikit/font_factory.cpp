#include "guikit/font_factory.h"

#include "config/system_services.h"
#include "guikit/apic_format.h"
#include "guikit/multicolor_font.h"
#include "guikit/unicolor_font.h"

namespace guikit {

std::unique_ptr<FontInterface> FontFactory::create_font(const char* name) const {
  const sys::Resource resource = sys::get_resource("APIC", name);
  if (!resource) return nullptr;
  return create_from_memory(resource.data, resource.size);
}

std::unique_ptr<FontInterface> FontFactory::create_from_memory(const uint8_t* data, size_t size) {
  ApicHeader h;
  if (read_apic_header(data, size, &h) != kApicOk) return nullptr;
  if (h.height < 1) return nullptr;  // the marker row is missing
  const Size dims{h.width, h.height};
  const uint8_t* pixels = data + h.pixel_offset;
  if (h.kind == kApicUnicolorFont && h.bits == 0) return std::make_unique<UnicolorFont>(dims, pixels);
  if (h.kind == kApicAlpha && h.bits == 8) {
    return std::make_unique<MulticolorFont>(dims, pixels, data + h.palette_offset);
  }
  return nullptr;
}

FontFactory& FontFactory::instance() {
  static FontFactory factory;
  return factory;
}

}  // namespace guikit
