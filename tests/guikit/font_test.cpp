// Bitmap fonts: cells from the marker row, both glyph blends, and text layout
// with alignment and clipping.

#include <gtest/gtest.h>

#include <memory>
#include <string>
#include <vector>

#include "guikit/apic_builder.h"
#include "guikit/font_factory.h"
#include "guikit/picture_test_util.h"

namespace {

using guikit::FontFactory;
using guikit::FontInterface;
using guikit::MemoryRenderingBuffer;
using guikit::Rect;
using guikit::Text;

struct LoadedFont {
  std::vector<uint8_t> bytes;
  std::unique_ptr<FontInterface> font;
};

LoadedFont load(const apic_test::ApicBuilder& builder) {
  LoadedFont l;
  l.bytes = builder.build();
  l.font = FontFactory::create_from_memory(l.bytes.data(), l.bytes.size());
  return l;
}

// A font of `cells` glyphs 2 rows high; glyph n is (n % 3) + 1 columns wide and every
// pixel of it has coverage 255, so drawn pixels are easy to find.
struct SolidFont {
  std::vector<int32_t> widths;
  LoadedFont loaded;
};

SolidFont solid_font(int cells) {
  SolidFont f;
  for (int n = 0; n < cells; ++n) f.widths.push_back(n % 3 + 1);
  int32_t width = 0;
  for (int32_t w : f.widths) width += w;
  f.loaded = load(apic_test::unicolor_font(f.widths, 2, std::vector<uint8_t>(2 * width, 255)));
  return f;
}

// Columns of row `y` that the text changed from the fill.
std::string row_mask(const MemoryRenderingBuffer& b, int32_t y, uint32_t fill) {
  std::string s;
  for (int32_t x = 0; x < b.get_width(); ++x) s += b.pixel(x, y) == fill ? '.' : '#';
  return s;
}

TEST(Font, MarkerRowRunsBecomeGlyphCells) {
  // Runs of any equal bytes count, not only 0/255 alternation.
  std::vector<uint8_t> coverage(2 * 9, 0);
  apic_test::ApicBuilder b = apic_test::unicolor_font({9}, 2, coverage);
  const uint8_t marker[9] = {7, 7, 0, 0, 0, 7, 255, 255, 3};
  for (int i = 0; i < 9; ++i) b.pixels[18 + i] = marker[i];
  LoadedFont l = load(b);
  ASSERT_TRUE(l.font);
  const int32_t expected[][2] = {{2, 0}, {3, 2}, {1, 5}, {2, 6}, {1, 8}};
  ASSERT_EQ(l.font->get_glyph_count(), 5);
  for (int32_t i = 0; i < 5; ++i) {
    EXPECT_EQ(l.font->get_glyph(i).width, expected[i][0]) << i;
    EXPECT_EQ(l.font->get_glyph(i).x, expected[i][1]) << i;
  }
  EXPECT_EQ(l.font->get_glyph_height(), 2);
}

TEST(Font, UnicolorGlyphBlendsTowardTheColourByCoverage) {
  const std::vector<uint8_t> coverage = {0, 1, 128, 255, 64, 200, 33, 0};
  LoadedFont l = load(apic_test::unicolor_font({4}, 2, coverage));
  ASSERT_TRUE(l.font);
  MemoryRenderingBuffer buffer = apic_test::patterned_buffer(6, 4);
  const MemoryRenderingBuffer before = buffer;
  const uint32_t colour = 0x00F08010;
  l.font->draw_text(Rect{1, 1, 6, 4}, colour, Text(std::string(1, '\0')), buffer);
  for (int32_t y = 0; y < 4; ++y) {
    for (int32_t x = 0; x < 6; ++x) {
      uint32_t want = before.pixel(x, y);
      if (x >= 1 && x <= 4 && y >= 1 && y <= 2) {
        want = apic_test::reference_toward(want, colour, coverage[(y - 1) * 4 + (x - 1)]);
      }
      EXPECT_EQ(buffer.pixel(x, y), want) << x << "," << y;
    }
  }
}

TEST(Font, MulticolorGlyphUsesItsPaletteAndTransparency) {
  const std::vector<uint32_t> palette = {0x00FF0000, 0x0000FF00, 0x000000FF};
  // 3 x 2 glyph rows plus a marker row of one cell (index 0 everywhere).
  std::vector<std::pair<uint8_t, uint8_t>> pairs = {{0, 0}, {1, 255}, {2, 100}, {1, 1}, {2, 254}, {0, 128},
                                                     {0, 9}, {0, 9},   {0, 9}};
  LoadedFont l = load(apic_test::alpha8(3, 3, palette, pairs));
  ASSERT_TRUE(l.font);
  ASSERT_EQ(l.font->get_glyph_count(), 1);
  MemoryRenderingBuffer buffer = apic_test::patterned_buffer(4, 3);
  const MemoryRenderingBuffer before = buffer;
  l.font->draw_text(Rect{0, 0, 4, 3}, 0x00FFFFFF, Text(std::string(1, '\0')), buffer);
  for (int32_t y = 0; y < 3; ++y) {
    for (int32_t x = 0; x < 4; ++x) {
      uint32_t want = before.pixel(x, y);
      if (x < 3 && y < 2) {
        const auto& p = pairs[y * 3 + x];
        want = apic_test::reference_toward(want, palette[p.first], 255 - p.second);
      }
      EXPECT_EQ(buffer.pixel(x, y), want) << x << "," << y;
    }
  }
}

TEST(Font, AlignmentLeftCentreRight) {
  SolidFont f = solid_font(4);  // glyph widths 1, 2, 3, 1
  ASSERT_TRUE(f.loaded.font);
  const std::string chars = {1, 0, 2};  // 2 + 1 + 3 = 6 pixels
  const uint32_t fill = 0;
  struct Case {
    int32_t alignment;
    int32_t left, right;
    const char* mask;
  };
  const Case cases[] = {
      {guikit::kAlignLeft, 2, 12, "..######......"},
      {guikit::kAlignCentre, 2, 12, "....######...."},
      {guikit::kAlignCentre, 2, 11, "...######....."},  // odd slack rounds down
      {guikit::kAlignRight, 2, 12, "......######.."},
      {7, 2, 12, "......######.."},  // any other value aligns right
  };
  for (const Case& c : cases) {
    MemoryRenderingBuffer buffer(14, 3, fill);
    f.loaded.font->draw_text(Rect{c.left, 0, c.right, 3}, 0x00FFFFFF, Text(chars, c.alignment), buffer);
    EXPECT_EQ(row_mask(buffer, 0, fill), c.mask) << c.alignment << " " << c.right;
    EXPECT_EQ(row_mask(buffer, 1, fill), c.mask);
    EXPECT_EQ(row_mask(buffer, 2, fill), "..............");  // marker row never drawn
  }
  // Each glyph lands where its predecessors' widths put it: glyph 1 (2 wide), then 0, then 2.
  MemoryRenderingBuffer buffer(14, 2, fill);
  const std::string spaced = {1, 3, 0, 3, 2};  // 2 + 1 + 1 + 1 + 3
  f.loaded.font->draw_text(Rect{0, 0, 14, 2}, 0x00FFFFFF, Text(spaced), buffer);
  EXPECT_EQ(row_mask(buffer, 0, fill), "########......");
}

TEST(Font, GlyphsAreCutAtTheRectangleAndBufferEdges) {
  // Cells of distinct coverage columns, so cut glyphs show which columns remain.
  std::vector<uint8_t> coverage = {10, 20, 30, 40, 50, 60};
  LoadedFont l = load(apic_test::unicolor_font({3, 3}, 1, coverage));
  ASSERT_TRUE(l.font);
  const std::string chars = {0, 1};
  const uint32_t colour = 0x00FFFFFF;
  auto level = [](int32_t c) { return static_cast<int32_t>((255 * c) >> 8); };
  struct Case {
    Rect rect;
    int32_t alignment;
    std::vector<int32_t> row;  // expected blue channel of buffer row 0, x = 0..7
  };
  const Case cases[] = {
      // Straddles the right edge of the rectangle: outside columns cut off.
      {Rect{1, 0, 5, 1}, guikit::kAlignLeft, {0, level(10), level(20), level(30), level(40), 0, 0, 0}},
      // Right-aligned text wider than its rectangle loses its first columns.
      {Rect{2, 0, 6, 1}, guikit::kAlignRight, {0, 0, level(30), level(40), level(50), level(60), 0, 0}},
      // Centred and too wide: starts left of the rectangle, cut on both sides.
      {Rect{3, 0, 7, 1}, guikit::kAlignCentre, {0, 0, 0, level(20), level(30), level(40), level(50), 0}},
      // Off the buffer's left edge: only the columns inside are drawn.
      {Rect{-4, 0, 8, 1}, guikit::kAlignLeft, {level(50), level(60), 0, 0, 0, 0, 0, 0}},
      // Off the buffer's right edge.
      {Rect{5, 0, 40, 1}, guikit::kAlignLeft, {0, 0, 0, 0, 0, level(10), level(20), level(30)}},
      // Alignment uses the whole rectangle even where the buffer (a repaint tile) cuts it.
      {Rect{-4, 0, 6, 1}, guikit::kAlignRight,
       {level(10), level(20), level(30), level(40), level(50), level(60), 0, 0}},
      {Rect{-3, 0, 7, 1}, guikit::kAlignCentre,
       {level(20), level(30), level(40), level(50), level(60), 0, 0, 0}},
      // Wholly outside.
      {Rect{9, 0, 20, 1}, guikit::kAlignLeft, {0, 0, 0, 0, 0, 0, 0, 0}},
  };
  for (const Case& c : cases) {
    MemoryRenderingBuffer buffer(8, 1, 0);
    l.font->draw_text(c.rect, colour, Text(chars, c.alignment), buffer);
    for (int32_t x = 0; x < 8; ++x) {
      EXPECT_EQ(apic_test::byte_of(buffer.pixel(x, 0), 0), c.row[x]) << c.rect.left << " align " << c.alignment
                                                                       << " x " << x;
    }
  }
}

TEST(Font, RowsAreCutToTheRectangleHeightAndTheBuffer) {
  // Three glyph rows of coverage 100, 150, 200.
  LoadedFont l = load(apic_test::unicolor_font({2}, 3, {100, 100, 150, 150, 200, 200}));
  ASSERT_TRUE(l.font);
  auto level = [](int32_t c) { return static_cast<int32_t>((255 * c) >> 8); };
  struct Case {
    Rect rect;
    std::vector<int32_t> column;  // blue of x = 0, y = 0..4
  };
  const Case cases[] = {
      {Rect{0, 1, 5, 3}, {0, level(100), level(150), 0, 0}},               // two rows fit
      {Rect{0, 1, 5, 10}, {0, level(100), level(150), level(200), 0}},     // all three, no marker row
      {Rect{0, -1, 5, 10}, {level(150), level(200), 0, 0, 0}},             // above the buffer
      {Rect{0, 3, 5, 10}, {0, 0, 0, level(100), level(150)}},              // below the buffer
      {Rect{0, 2, 5, 2}, {0, 0, 0, 0, 0}},                                 // empty rectangle
  };
  for (const Case& c : cases) {
    MemoryRenderingBuffer buffer(2, 5, 0);
    l.font->draw_text(c.rect, 0x00FFFFFF, Text(std::string(1, '\0')), buffer);
    for (int32_t y = 0; y < 5; ++y) {
      EXPECT_EQ(apic_test::byte_of(buffer.pixel(0, y), 0), c.column[y]) << c.rect.top << " y " << y;
      EXPECT_EQ(buffer.pixel(0, y), buffer.pixel(1, y));
    }
  }
}

TEST(Font, BytesWithoutAGlyphAreSkippedWithoutAdvancing) {
  SolidFont big = solid_font(256);
  ASSERT_TRUE(big.loaded.font);
  ASSERT_EQ(big.loaded.font->get_glyph_count(), 256);
  const std::string last(1, static_cast<char>(255));
  Text text(last);
  text.measure(*big.loaded.font);
  EXPECT_EQ(text.get_pixel_width(), big.widths[255]);
  EXPECT_EQ(text.get_pixel_height(), 2);
  MemoryRenderingBuffer drawn(6, 2, 0);
  big.loaded.font->draw_text(Rect{0, 0, 6, 2}, 0x00FFFFFF, text, drawn);
  EXPECT_EQ(row_mask(drawn, 0, 0), std::string(big.widths[255], '#') + std::string(6 - big.widths[255], '.'));

  SolidFont small = solid_font(3);  // widths 1, 2, 3
  ASSERT_TRUE(small.loaded.font);
  const std::string chars = {2, static_cast<char>(255), 5, 1};
  EXPECT_EQ(small.loaded.font->get_text_width(chars.data(), chars.size()), 5);
  MemoryRenderingBuffer buffer(8, 2, 0);
  small.loaded.font->draw_text(Rect{0, 0, 8, 2}, 0x00FFFFFF, Text(chars, guikit::kAlignRight), buffer);
  EXPECT_EQ(row_mask(buffer, 0, 0), "...#####");
}

}  // namespace
