// The "APIC" picture resource: a 36-byte little-endian header, a palette of
// blue-green-red-zero entries and the pixel rows. Pictures are quantised to one
// 256-colour palette each with fixed settings, so the same image always gives the
// same bytes.
#pragma once

#include <cstdint>
#include <vector>

#include "paint.h"

namespace skin {

enum ApicKind { kApicOpaque = 0, kApicAlpha = 1, kApicUnicolorFont = 2 };

// Palette-indexed picture: opaque (one index byte a pixel) or with opacity
// (index and opacity byte pairs). The opacity kept is the drawn one, not the palette's.
std::vector<uint8_t> encode_indexed(const RgbaImage& image, ApicKind kind, uint32_t flag);
// Unicolour font: one coverage byte a pixel, no palette.
std::vector<uint8_t> encode_coverage(int width, int height, const std::vector<uint8_t>& coverage, uint32_t flag);

// Reads any of the above back to straight RGBA (a font as white with its coverage as
// opacity); used for the preview sheets, so they show what the module embeds.
RgbaImage decode_apic(const std::vector<uint8_t>& bytes);

}  // namespace skin
