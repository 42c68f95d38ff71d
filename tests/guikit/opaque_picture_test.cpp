// Opaque pictures: palette and true-colour copies, clipping at every edge, and the
// whole-pixel rules for fractional and rotated drawing.

#include <gtest/gtest.h>

#include <memory>
#include <vector>

#include "guikit/apic_builder.h"
#include "guikit/pic_data_factory.h"
#include "guikit/picture_test_util.h"

namespace {

using apic_test::ApicBuilder;
using guikit::MemoryRenderingBuffer;
using guikit::PicDataFactory;
using guikit::PicDataInterface;
using guikit::Rect;
using guikit::Size;

constexpr int32_t kW = 5;
constexpr int32_t kH = 4;

const std::vector<uint32_t> kPalette = {0x00102030, 0x00FF0000, 0x0000FF00, 0x000000FF, 0x00ABCDEF};

std::vector<uint8_t> picture_indices() {
  std::vector<uint8_t> idx;
  for (int32_t i = 0; i < kW * kH; ++i) idx.push_back(static_cast<uint8_t>((i * 3 + i / kW) % kPalette.size()));
  return idx;
}

uint32_t expected_colour8(int32_t x, int32_t y) { return kPalette[picture_indices()[y * kW + x]]; }

std::vector<uint32_t> true_colour_words() {
  std::vector<uint32_t> w;
  for (int32_t i = 0; i < kW * kH; ++i) w.push_back(0x5A000000u * (i % 2) + 0x00010203u * static_cast<uint32_t>(i + 1));
  return w;
}

struct Case {
  Rect view;
  Rect clip;
};

// Positions on and across every buffer edge, with clips that cut each picture edge.
std::vector<Case> edge_cases(int32_t bw, int32_t bh) {
  std::vector<Case> cases;
  const Rect no_clip{-1000, -1000, 1000, 1000};
  const Rect clips[] = {no_clip, {1, 0, 5, 4}, {0, 1, 5, 4}, {0, 0, 4, 4}, {0, 0, 5, 3}, {2, 1, 3, 2}, {3, 3, 3, 4}};
  for (int32_t px = -kW - 1; px <= bw + 1; ++px) {
    for (int32_t py = -kH - 1; py <= bh + 1; ++py) {
      for (const Rect& clip : clips) cases.push_back({Rect{-px, -py, -px + bw, -py + bh}, clip});
    }
  }
  // A view narrower than the buffer limits drawing too.
  cases.push_back({Rect{-1, -1, 2, 3}, no_clip});
  return cases;
}

template <class Expected>
void check_against_reference(const PicDataInterface& pic, Expected expected) {
  const int32_t bw = 7;
  const int32_t bh = 6;
  for (const Case& c : edge_cases(bw, bh)) {
    MemoryRenderingBuffer buffer = apic_test::patterned_buffer(bw, bh);
    const MemoryRenderingBuffer before = buffer;
    ASSERT_EQ(pic.draw(c.view, buffer, c.clip), 0);
    for (int32_t y = 0; y < bh; ++y) {
      for (int32_t x = 0; x < bw; ++x) {
        const int32_t sx = x + c.view.left;
        const int32_t sy = y + c.view.top;
        const uint32_t want =
            apic_test::shown(sx, sy, kW, kH, c.view, c.clip) ? expected(sx, sy) : before.pixel(x, y);
        ASSERT_EQ(buffer.pixel(x, y), want) << "view " << c.view.left << "," << c.view.top << " clip "
                                            << c.clip.left << "," << c.clip.top << "," << c.clip.right << ","
                                            << c.clip.bottom << " at " << x << "," << y;
      }
    }
  }
}

TEST(OpaquePicture, PaletteCopyMatchesReferenceAcrossEveryEdge) {
  const auto bytes = apic_test::opaque8(kW, kH, kPalette, picture_indices()).build();
  auto pic = PicDataFactory::create_from_memory(bytes.data(), bytes.size());
  ASSERT_TRUE(pic);
  EXPECT_EQ(pic->get_width(), kW);
  EXPECT_EQ(pic->get_height(), kH);
  check_against_reference(*pic, expected_colour8);
}

TEST(OpaquePicture, TrueColourCopiesWholeWordsAcrossEveryEdge) {
  const auto words = true_colour_words();
  const auto bytes = apic_test::true_colour(0, kW, kH, words).build();
  auto pic = PicDataFactory::create_from_memory(bytes.data(), bytes.size());
  ASSERT_TRUE(pic);
  check_against_reference(*pic, [&](int32_t x, int32_t y) { return words[y * kW + x]; });
}

TEST(OpaquePicture, FractionalPlacementSnapsDownAndFadingIsIgnored) {
  const auto bytes = apic_test::opaque8(kW, kH, kPalette, picture_indices()).build();
  auto pic = PicDataFactory::create_from_memory(bytes.data(), bytes.size());
  ASSERT_TRUE(pic);
  const Rect all{-100, -100, 100, 100};
  const Size size{9, 8};
  struct Placement {
    float x, y;
    int32_t px, py;
    bool faded;
  };
  const Placement placements[] = {
      {2.0f, 3.0f, 2, 3, false}, {2.75f, 1.25f, 2, 1, false}, {-0.5f, -1.5f, -1, -2, false},
      {2.0f, 3.0f, 2, 3, true},  {2.5f, 1.0f, 2, 1, true},    {-0.25f, 4.0f, -1, 4, true},
  };
  for (const Placement& p : placements) {
    MemoryRenderingBuffer got = apic_test::patterned_buffer(9, 8);
    MemoryRenderingBuffer want = got;
    if (p.faded) {
      pic->draw_at_faded(p.x, p.y, size, got, all, 0.25f);
    } else {
      pic->draw_at(p.x, p.y, size, got, all);
    }
    pic->draw(guikit::view_for_position(p.px, p.py, size), want, all);
    EXPECT_EQ(apic_test::snapshot(got), apic_test::snapshot(want)) << p.x << "," << p.y;
    EXPECT_NE(apic_test::snapshot(got), apic_test::snapshot(apic_test::patterned_buffer(9, 8)));
  }
}

TEST(OpaquePicture, RotationDrawsNothing) {
  const auto bytes = apic_test::true_colour(0, kW, kH, true_colour_words()).build();
  auto pic = PicDataFactory::create_from_memory(bytes.data(), bytes.size());
  ASSERT_TRUE(pic);
  MemoryRenderingBuffer buffer = apic_test::patterned_buffer(8, 8);
  const auto before = apic_test::snapshot(buffer);
  EXPECT_EQ(pic->draw_rotated(3.0f, 3.0f, 0.0f, buffer, Rect{0, 0, 8, 8}), 0);
  EXPECT_EQ(pic->draw_rotated_faded(3.0f, 3.0f, 1.0f, buffer, Rect{0, 0, 8, 8}, 1.0f), 0);
  EXPECT_EQ(apic_test::snapshot(buffer), before);
}

TEST(OpaquePicture, AbsurdCoordinatesDrawNothing) {
  const auto bytes = apic_test::opaque8(kW, kH, kPalette, picture_indices()).build();
  auto pic = PicDataFactory::create_from_memory(bytes.data(), bytes.size());
  ASSERT_TRUE(pic);
  MemoryRenderingBuffer buffer = apic_test::patterned_buffer(8, 8);
  const auto before = apic_test::snapshot(buffer);
  const Rect all{-100, -100, 100, 100};
  pic->draw_at(1e30f, 0.0f, Size{8, 8}, buffer, all);
  pic->draw_at_faded(0.0f, -1e30f, Size{8, 8}, buffer, all, 1.0f);
  pic->draw_at(std::nanf(""), 0.0f, Size{8, 8}, buffer, all);
  pic->draw(Rect{INT32_MIN, INT32_MIN, INT32_MAX, INT32_MAX}, buffer, all);
  EXPECT_EQ(apic_test::snapshot(buffer), before);
}

}  // namespace
