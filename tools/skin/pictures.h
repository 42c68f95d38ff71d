// One generated resource before it is encoded.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "apic_codec.h"
#include "paint.h"
#include "skin_layout.h"

namespace skin {

constexpr uint32_t kFlagDefault = 0xFFFFFFFFu;
constexpr uint32_t kFlagOne = 1u;  // fonts, push buttons, the small knob, the lamps

struct Picture {
  std::string name;
  ApicKind kind = kApicAlpha;
  uint32_t flag = kFlagDefault;
  RgbaImage image;                // opaque and alpha pictures
  std::vector<uint8_t> coverage;  // fonts: image.width x image.height coverage bytes
  int family = -1;                // index into kFamilies, -1 for backgrounds and fonts
};

void add_control_pictures(std::vector<Picture>& out);
void add_backgrounds(std::vector<Picture>& out);
void add_fonts(std::vector<Picture>& out);

}  // namespace skin
