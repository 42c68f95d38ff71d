#include "apic_codec.h"

#include <libimagequant.h>

#include <stdexcept>

namespace skin {

namespace {

void put32(std::vector<uint8_t>& out, uint32_t v) {
  for (int i = 0; i < 4; ++i) {
    out.push_back(static_cast<uint8_t>(v >> (8 * i)));
  }
}

int32_t get32(const std::vector<uint8_t>& in, size_t at) {
  if (at + 4 > in.size()) {
    throw std::runtime_error("make_skin: truncated picture");
  }
  uint32_t v = 0;
  for (int i = 0; i < 4; ++i) {
    v |= static_cast<uint32_t>(in[at + i]) << (8 * i);
  }
  return static_cast<int32_t>(v);
}

constexpr int kHeaderSize = 36;

void put_header(std::vector<uint8_t>& out, uint32_t flag, int kind, int bits, int width, int height, int palette) {
  put32(out, flag);
  put32(out, kHeaderSize);
  put32(out, static_cast<uint32_t>(kind));
  put32(out, static_cast<uint32_t>(bits));
  put32(out, static_cast<uint32_t>(width));
  put32(out, static_cast<uint32_t>(height));
  put32(out, static_cast<uint32_t>(palette));
  put32(out, static_cast<uint32_t>(kHeaderSize + 4 * palette));
  put32(out, palette > 0 ? kHeaderSize : 0);
}

struct Quantised {
  std::vector<uint8_t> indices;
  std::vector<liq_color> palette;
};

Quantised quantise(const RgbaImage& image) {
  liq_attr* attr = liq_attr_create();
  liq_set_max_colors(attr, 256);
  liq_set_speed(attr, 3);
  liq_set_quality(attr, 0, 100);
  liq_image* input = liq_image_create_rgba(attr, image.rgba.data(), image.width, image.height, 0);
  liq_result* result = nullptr;
  if (input == nullptr || liq_image_quantize(input, attr, &result) != LIQ_OK) {
    throw std::runtime_error("make_skin: quantisation failed");
  }
  liq_set_dithering_level(result, 0.6f);
  Quantised q;
  q.indices.resize(static_cast<size_t>(image.width) * image.height);
  if (liq_write_remapped_image(result, input, q.indices.data(), q.indices.size()) != LIQ_OK) {
    throw std::runtime_error("make_skin: remapping failed");
  }
  const liq_palette* palette = liq_get_palette(result);
  q.palette.assign(palette->entries, palette->entries + palette->count);
  liq_result_destroy(result);
  liq_image_destroy(input);
  liq_attr_destroy(attr);
  return q;
}

}  // namespace

std::vector<uint8_t> encode_indexed(const RgbaImage& image, ApicKind kind, uint32_t flag) {
  RgbaImage source = image;
  if (kind == kApicOpaque) {
    for (size_t i = 3; i < source.rgba.size(); i += 4) {
      source.rgba[i] = 255;
    }
  }
  const Quantised q = quantise(source);
  std::vector<uint8_t> out;
  put_header(out, flag, kind, 8, image.width, image.height, static_cast<int>(q.palette.size()));
  for (const liq_color& c : q.palette) {
    out.push_back(c.b);
    out.push_back(c.g);
    out.push_back(c.r);
    out.push_back(0);
  }
  for (size_t i = 0; i < q.indices.size(); ++i) {
    out.push_back(q.indices[i]);
    if (kind == kApicAlpha) {
      out.push_back(source.rgba[i * 4 + 3]);
    }
  }
  return out;
}

std::vector<uint8_t> encode_coverage(int width, int height, const std::vector<uint8_t>& coverage, uint32_t flag) {
  if (coverage.size() != static_cast<size_t>(width) * height) {
    throw std::runtime_error("make_skin: font coverage of the wrong size");
  }
  std::vector<uint8_t> out;
  put_header(out, flag, kApicUnicolorFont, 0, width, height, 0);
  out[28] = kHeaderSize;  // pixels follow the header directly
  out.insert(out.end(), coverage.begin(), coverage.end());
  return out;
}

RgbaImage decode_apic(const std::vector<uint8_t>& bytes) {
  const int kind = get32(bytes, 8);
  const int bits = get32(bytes, 12);
  RgbaImage img;
  img.width = get32(bytes, 16);
  img.height = get32(bytes, 20);
  const int palette_count = get32(bytes, 24);
  const size_t pixels = static_cast<size_t>(get32(bytes, 28));
  const size_t palette = static_cast<size_t>(get32(bytes, 32));
  const size_t count = static_cast<size_t>(img.width) * img.height;
  const size_t per_pixel = kind == kApicAlpha ? 2 : 1;
  if (pixels + count * per_pixel > bytes.size() || (bits == 8 && palette + 4 * palette_count > bytes.size())) {
    throw std::runtime_error("make_skin: truncated picture");
  }
  img.rgba.resize(count * 4);
  for (size_t i = 0; i < count; ++i) {
    uint8_t* d = &img.rgba[i * 4];
    if (kind == kApicUnicolorFont) {
      d[0] = d[1] = d[2] = 255;
      d[3] = bytes[pixels + i];
      continue;
    }
    const uint8_t index = bytes[pixels + i * per_pixel];
    const uint8_t* entry = &bytes[palette + 4 * index];
    d[0] = entry[2];
    d[1] = entry[1];
    d[2] = entry[0];
    d[3] = kind == kApicAlpha ? bytes[pixels + i * 2 + 1] : 255;
  }
  return img;
}

}  // namespace skin
