#include "guikit/pic_data_factory.h"

#include "config/system_services.h"
#include "guikit/alpha_pic_data24.h"
#include "guikit/alpha_pic_data8.h"
#include "guikit/apic_format.h"
#include "guikit/pic_data24.h"
#include "guikit/pic_data8.h"

namespace guikit {

std::unique_ptr<PicDataInterface> PicDataFactory::create_picture(const char* name) const {
  const sys::Resource resource = sys::get_resource("APIC", name);
  if (!resource) return nullptr;
  return create_from_memory(resource.data, resource.size);
}

std::unique_ptr<PicDataInterface> PicDataFactory::create_from_memory(const uint8_t* data, size_t size) {
  ApicHeader h;
  if (read_apic_header(data, size, &h) != kApicOk) return nullptr;
  const Size dims{h.width, h.height};
  const uint8_t* pixels = data + h.pixel_offset;
  const uint8_t* palette = data + h.palette_offset;
  if (h.kind == kApicOpaque && h.bits == 8) return std::make_unique<PicData8>(dims, pixels, palette);
  if (h.kind == kApicOpaque && h.bits == 24) return std::make_unique<PicData24>(dims, pixels);
  if (h.kind == kApicAlpha && h.bits == 8) return std::make_unique<AlphaPicData8>(dims, pixels, palette);
  if (h.kind == kApicAlpha && h.bits == 24) return std::make_unique<AlphaPicData24>(dims, pixels);
  return nullptr;
}

PicDataFactory& PicDataFactory::instance() {
  static PicDataFactory factory;
  return factory;
}

}  // namespace guikit
