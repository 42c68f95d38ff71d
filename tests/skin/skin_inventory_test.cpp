// Every picture and font the editor asks for is embedded, readable, and of the size
// or frame count the editor expects.
#include <gtest/gtest.h>

#include <cstdio>
#include <cstring>
#include <string>
#include <vector>

#include "config/resource_table.h"
#include "guikit/font_factory.h"
#include "guikit/text.h"
#include "skin/skin_test_support.h"

namespace {

using skin_test::picture;

struct Expected {
  std::string name;
  int width;
  int height;
};

std::string numbered(const char* stem, int n, int digits) {
  char text[32];
  std::snprintf(text, sizeof text, "%s_%0*d", stem, digits, n);
  return text;
}

const std::vector<Expected> kBackgroundSizes = {
    {"bkg_24_master", 147, 229}, {"bkg_24_top", 462, 36},    {"bkg_24_band1", 115, 193},
    {"bkg_24_band2", 114, 193},  {"bkg_24_band3", 114, 193}, {"bkg_24_band4", 119, 193},
    {"bkg_24_tip1", 114, 193},   {"bkg_24_tip2pc", 114, 193}, {"bkg_24_tip3", 119, 193},
    {"bkg_24_edit", 117, 53},    {"bkg_24_presets", 239, 53}, {"bkg_24_info", 253, 53},
};

// Every name of a frame strip has the same size, and the strip stops at its count.
void expect_strip(const char* stem, int frames, int digits) {
  std::unique_ptr<guikit::PicDataInterface> first = picture(numbered(stem, 0, digits));
  ASSERT_NE(first, nullptr) << stem;
  for (int i = 1; i < frames; ++i) {
    std::unique_ptr<guikit::PicDataInterface> frame = picture(numbered(stem, i, digits));
    ASSERT_NE(frame, nullptr) << numbered(stem, i, digits);
    EXPECT_EQ(frame->get_width(), first->get_width()) << numbered(stem, i, digits);
    EXPECT_EQ(frame->get_height(), first->get_height()) << numbered(stem, i, digits);
  }
  EXPECT_EQ(picture(numbered(stem, frames, digits)), nullptr) << stem << " has more than " << frames << " frames";
}

int32_t le32(const uint8_t* p) {
  return static_cast<int32_t>(p[0] | (p[1] << 8) | (p[2] << 16) | (static_cast<uint32_t>(p[3]) << 24));
}

TEST(SkinInventory, BackgroundsHaveTheEditorSizesAndAreOpaque) {
  for (const Expected& e : kBackgroundSizes) {
    std::unique_ptr<guikit::PicDataInterface> pic = picture(e.name);
    ASSERT_NE(pic, nullptr) << e.name;
    EXPECT_EQ(pic->get_width(), e.width) << e.name;
    EXPECT_EQ(pic->get_height(), e.height) << e.name;
    // An opaque picture covers every pixel of its rectangle on any surface.
    skin_test::Footprint footprint;
    footprint.add(*pic, 0, 0);
    EXPECT_EQ(footprint.bounds(), (guikit::Rect{0, 0, e.width, e.height})) << e.name;
    for (int y = 0; y < e.height; y += 7) {
      for (int x = 0; x < e.width; x += 5) {
        ASSERT_TRUE(footprint.touched(x, y)) << e.name << " leaves (" << x << ", " << y << ")";
      }
    }
  }
}

TEST(SkinInventory, NamesAreFoundInAnyCase) {
  std::unique_ptr<guikit::PicDataInterface> lower = picture("bkg_24_band1");
  std::unique_ptr<guikit::PicDataInterface> upper = picture("BKG_24_BAND1");
  ASSERT_NE(lower, nullptr);
  ASSERT_NE(upper, nullptr);
  EXPECT_EQ(upper->get_width(), lower->get_width());
  EXPECT_EQ(upper->get_height(), lower->get_height());
  EXPECT_NE(picture("Kn_26_S"), nullptr);
  EXPECT_EQ(picture("kn_26_"), nullptr);
}

TEST(SkinInventory, FrameStripsHaveTheirCounts) {
  expect_strip("kn_26", 97, 2);
  for (const char* stem : {"ff_04", "ff_16", "ff_17", "ff_18", "pb_11", "pb_12", "pb_13", "pb_14", "pb_15", "pb_16",
                           "pb_17", "pb_18"}) {
    expect_strip(stem, 5, 1);
  }
  expect_strip("pb_53", 2, 1);
  expect_strip("tl_01", 2, 1);
}

TEST(SkinInventory, FixedSizesTheLayoutDependsOn) {
  const std::vector<Expected> fixed = {{"tl_01_0", 11, 11}, {"tl_01_1", 11, 11}, {"pb_53_0", 57, 14},
                                       {"pb_53_1", 57, 14}, {"pb_11_0", 13, 13}, {"pb_18_4", 13, 13}};
  for (const Expected& e : fixed) {
    std::unique_ptr<guikit::PicDataInterface> pic = picture(e.name);
    ASSERT_NE(pic, nullptr) << e.name;
    EXPECT_EQ(pic->get_width(), e.width) << e.name;
    EXPECT_EQ(pic->get_height(), e.height) << e.name;
  }
  // The fader's track must carry the cap over its whole 437-pixel travel.
  std::unique_ptr<guikit::PicDataInterface> cap = picture("fd_09");
  std::unique_ptr<guikit::PicDataInterface> track = picture("fd_09_s");
  ASSERT_NE(cap, nullptr);
  ASSERT_NE(track, nullptr);
  EXPECT_GE(track->get_width(), 437 + cap->get_width());
  for (const char* name : {"kn_26_p", "kn_26_s", "ff_16_p", "kn_08", "kn_08_spn"}) {
    EXPECT_NE(picture(name), nullptr) << name;
  }
}

TEST(SkinInventory, FourMetersWithNeedleFaceAndCover) {
  for (int n = 1; n <= 4; ++n) {
    const std::string stem = "vn_0" + std::to_string(n);
    std::unique_ptr<guikit::PicDataInterface> needle = picture(stem);
    std::unique_ptr<guikit::PicDataInterface> face = picture(stem + "_p");
    std::unique_ptr<guikit::PicDataInterface> cover = picture(stem + "_o");
    ASSERT_NE(needle, nullptr) << stem;
    ASSERT_NE(face, nullptr) << stem;
    ASSERT_NE(cover, nullptr) << stem;
    EXPECT_EQ(cover->get_width(), face->get_width());
    EXPECT_EQ(cover->get_height(), face->get_height());
  }
  EXPECT_EQ(picture("vn_05"), nullptr);
}

TEST(SkinInventory, ResourceTableHoldsExactlyTheSkinKinds) {
  int kinds[3] = {0, 0, 0};
  for (int i = 0; i < brakmorph_resource_count; ++i) {
    const sys::ResourceEntry& e = brakmorph_resource_table[i];
    if (std::strcmp(e.type, "APIC") != 0) continue;
    ASSERT_GE(e.size, 36u) << e.name;
    const uint8_t* d = e.data;
    EXPECT_NE(le32(d), 0) << e.name;
    EXPECT_EQ(le32(d + 4), 36) << e.name;
    const int kind = le32(d + 8), bits = le32(d + 12), width = le32(d + 16), height = le32(d + 20);
    const int palette = le32(d + 24), pixels = le32(d + 28);
    ASSERT_GE(kind, 0) << e.name;
    ASSERT_LE(kind, 2) << e.name;
    ++kinds[kind];
    EXPECT_EQ(bits, kind == 2 ? 0 : 8) << e.name;
    EXPECT_LE(palette, 256) << e.name;
    EXPECT_EQ(pixels, 36 + 4 * palette) << e.name;
    EXPECT_EQ(le32(d + 32), palette > 0 ? 36 : 0) << e.name;
    const size_t per_pixel = kind == 1 ? 2 : 1;
    EXPECT_EQ(e.size, static_cast<size_t>(pixels) + per_pixel * width * height) << e.name;
    // Every index points into the palette.
    for (size_t k = 0; kind != 2 && k < static_cast<size_t>(width) * height; ++k) {
      ASSERT_LT(d[pixels + k * per_pixel], palette) << e.name;
    }
  }
  EXPECT_EQ(kinds[0], 12);
  EXPECT_EQ(kinds[1], 180);
  EXPECT_EQ(kinds[2], 2);
}

struct FontCase {
  const char* name;
  int width;
  int glyph_height;
};

TEST(SkinInventory, FontsHave256CellsOfTheirHeight) {
  for (const FontCase& f : {FontCase{"font_03", 1863, 12}, FontCase{"font_04", 1946, 14}}) {
    std::unique_ptr<guikit::FontInterface> font = guikit::FontFactory::instance().create_font(f.name);
    ASSERT_NE(font, nullptr) << f.name;
    EXPECT_EQ(font->get_glyph_count(), 256) << f.name;
    EXPECT_EQ(font->get_glyph_height(), f.glyph_height) << f.name;
    int32_t x = 0;
    for (int i = 0; i < 256; ++i) {
      const guikit::Glyph g = font->get_glyph(i);
      EXPECT_EQ(g.x, x) << f.name << " glyph " << i;
      EXPECT_GE(g.width, 1) << f.name << " glyph " << i;
      x += g.width;
    }
    EXPECT_EQ(x, f.width) << f.name;
  }
}

// Pixels a glyph sets when drawn in white on black.
int glyph_ink(const guikit::FontInterface& font, unsigned char ch) {
  const guikit::Glyph g = font.get_glyph(ch);
  guikit::MemoryRenderingBuffer buffer(g.width, font.get_glyph_height(), 0);
  font.draw_glyph(guikit::Rect{g.x, 0, g.x + g.width, font.get_glyph_height()}, guikit::Point{0, 0}, buffer,
                  0x00FFFFFF);
  int ink = 0;
  for (int y = 0; y < font.get_glyph_height(); ++y) {
    for (int x = 0; x < g.width; ++x) {
      ink += (buffer.pixel(x, y) & 0xFF) > 96 ? 1 : 0;
    }
  }
  return ink;
}

TEST(SkinInventory, FontGlyphsAreLegibleWhereTextIsExpected) {
  for (const char* name : {"font_03", "font_04"}) {
    std::unique_ptr<guikit::FontInterface> font = guikit::FontFactory::instance().create_font(name);
    ASSERT_NE(font, nullptr) << name;
    EXPECT_EQ(glyph_ink(*font, ' '), 0) << name;
    for (unsigned char ch : std::string("09AZaz%\xE9\x80")) {
      EXPECT_GE(glyph_ink(*font, ch), 4) << name << " glyph " << static_cast<int>(ch);
    }
    for (unsigned char ch : std::string(".-:")) {
      EXPECT_GE(glyph_ink(*font, ch), 1) << name << " glyph " << static_cast<int>(ch);
    }
    // Digits share one width, so a right-aligned number does not shift as it changes.
    for (char d = '1'; d <= '9'; ++d) {
      EXPECT_EQ(font->get_glyph(d).width, font->get_glyph('0').width) << name << " digit " << d;
    }
    // Text that fits its box draws inside it and nowhere else.
    const int h = font->get_glyph_height();
    guikit::MemoryRenderingBuffer buffer(80, h + 6, 0);
    guikit::Text text("10.0", guikit::kAlignRight);
    text.measure(*font);
    font->draw_text(guikit::Rect{20, 3, 60, 3 + h}, 0x0000FFFF, text, buffer);
    int ink_inside = 0, ink_outside = 0;
    for (int y = 0; y < h + 6; ++y) {
      for (int x = 0; x < 80; ++x) {
        if (buffer.pixel(x, y) == 0) continue;
        const bool in = x >= 60 - text.get_pixel_width() && x < 60 && y >= 3 && y < 3 + h;
        ++(in ? ink_inside : ink_outside);
      }
    }
    EXPECT_GT(ink_inside, 10) << name;
    EXPECT_EQ(ink_outside, 0) << name;
  }
}

}  // namespace
