// Pictures with opacity: the two whole-pixel blend rules, sub-pixel placement and
// rotation, each against a reference worked out in double precision here.

#include <gtest/gtest.h>

#include <cmath>
#include <memory>
#include <vector>

#include "guikit/apic_builder.h"
#include "guikit/pic_data_factory.h"
#include "guikit/picture_test_util.h"

namespace {

using guikit::MemoryRenderingBuffer;
using guikit::PicDataFactory;
using guikit::PicDataInterface;
using guikit::Rect;
using guikit::Size;

const Rect kAll{-1000, -1000, 1000, 1000};
const std::vector<uint32_t> kPalette = {0x00FFFFFF, 0x00000000, 0x00C08040, 0x0010F0A0};

struct Loaded {
  std::vector<uint8_t> bytes;
  std::unique_ptr<PicDataInterface> pic;
};

Loaded load(const apic_test::ApicBuilder& builder) {
  Loaded l;
  l.bytes = builder.build();
  l.pic = PicDataFactory::create_from_memory(l.bytes.data(), l.bytes.size());
  return l;
}

// A 4 x 3 palette picture whose opacities cover 0, 255 and values between.
std::vector<std::pair<uint8_t, uint8_t>> mixed_pairs() {
  const uint8_t alphas[] = {0, 255, 1, 128, 254, 77, 200, 3, 255, 0, 90, 160};
  std::vector<std::pair<uint8_t, uint8_t>> pairs;
  for (int i = 0; i < 12; ++i) pairs.push_back({static_cast<uint8_t>(i % 4), alphas[i]});
  return pairs;
}

// (s * a + d * (255 - a)) / 256 floored, in double.
uint32_t reference_mix(uint32_t d, uint32_t s, int32_t a) {
  uint32_t out = d & 0xFF000000u;
  for (int c = 0; c < 3; ++c) {
    const double v = std::floor((apic_test::byte_of(s, c) * a + apic_test::byte_of(d, c) * (255.0 - a)) / 256.0);
    out |= static_cast<uint32_t>(v) << (8 * c);
  }
  return out;
}

TEST(AlphaPicture, PaletteBlendFollowsRuleAWithClipping) {
  const auto pairs = mixed_pairs();
  Loaded l = load(apic_test::alpha8(4, 3, kPalette, pairs));
  ASSERT_TRUE(l.pic);
  const Rect clips[] = {kAll, {1, 1, 3, 3}, {0, 0, 4, 1}, {3, 0, 9, 9}};
  for (int32_t px = -4; px <= 6; ++px) {
    for (const Rect& clip : clips) {
      MemoryRenderingBuffer buffer = apic_test::patterned_buffer(6, 4);
      const MemoryRenderingBuffer before = buffer;
      const Rect view{-px, 1, -px + 6, 5};
      l.pic->draw(view, buffer, clip);
      for (int32_t y = 0; y < 4; ++y) {
        for (int32_t x = 0; x < 6; ++x) {
          const int32_t sx = x + view.left;
          const int32_t sy = y + view.top;
          uint32_t want = before.pixel(x, y);
          if (apic_test::shown(sx, sy, 4, 3, view, clip)) {
            const auto& p = pairs[sy * 4 + sx];
            if (p.second == 255) {
              want = kPalette[p.first];  // whole word, fourth byte included
            } else if (p.second != 0) {
              want = apic_test::reference_toward(want, kPalette[p.first], p.second);
            }
          }
          ASSERT_EQ(buffer.pixel(x, y), want) << px << " " << x << "," << y;
        }
      }
    }
  }
}

TEST(AlphaPicture, TrueColourBlendFollowsRuleB) {
  std::vector<uint32_t> words;
  const uint32_t alphas[] = {0, 1, 64, 128, 200, 254, 255, 17};
  for (int i = 0; i < 8; ++i) words.push_back(alphas[i] << 24 | (0x00F03C80u + 0x00050B11u * static_cast<uint32_t>(i)));
  Loaded l = load(apic_test::true_colour(1, 4, 2, words));
  ASSERT_TRUE(l.pic);
  MemoryRenderingBuffer buffer = apic_test::patterned_buffer(5, 3);
  const MemoryRenderingBuffer before = buffer;
  l.pic->draw(guikit::view_for_position(1, 1, Size{5, 3}), buffer, kAll);
  for (int32_t y = 0; y < 3; ++y) {
    for (int32_t x = 0; x < 5; ++x) {
      uint32_t want = before.pixel(x, y);
      if (x >= 1 && y >= 1) {
        const uint32_t s = words[(y - 1) * 4 + (x - 1)];
        const int32_t a = static_cast<int32_t>(s >> 24);
        want = a == 0 ? want : a == 255 ? s : reference_mix(want, s, a);
      }
      EXPECT_EQ(buffer.pixel(x, y), want) << x << "," << y;
    }
  }
}

TEST(AlphaPicture, FullyTransparentLeavesBufferAndFullyOpaqueMatchesOpaqueClass) {
  std::vector<uint8_t> indices = {0, 1, 2, 3, 3, 2};
  std::vector<std::pair<uint8_t, uint8_t>> clear, solid;
  for (uint8_t i : indices) {
    clear.push_back({i, 0});
    solid.push_back({i, 255});
  }
  Loaded transparent = load(apic_test::alpha8(3, 2, kPalette, clear));
  Loaded opaque_alpha = load(apic_test::alpha8(3, 2, kPalette, solid));
  Loaded opaque = load(apic_test::opaque8(3, 2, kPalette, indices));
  ASSERT_TRUE(transparent.pic && opaque_alpha.pic && opaque.pic);
  const Rect view = guikit::view_for_position(1, 2, Size{5, 5});

  MemoryRenderingBuffer a = apic_test::patterned_buffer(5, 5);
  const auto untouched = apic_test::snapshot(a);
  transparent.pic->draw(view, a, kAll);
  transparent.pic->draw_at(1.3f, 0.6f, Size{5, 5}, a, kAll);
  transparent.pic->draw_rotated(2.0f, 2.0f, 0.7f, a, kAll);
  EXPECT_EQ(apic_test::snapshot(a), untouched);

  MemoryRenderingBuffer b = apic_test::patterned_buffer(5, 5);
  MemoryRenderingBuffer c = apic_test::patterned_buffer(5, 5);
  opaque_alpha.pic->draw(view, b, kAll);
  opaque.pic->draw(view, c, kAll);
  EXPECT_EQ(apic_test::snapshot(b), apic_test::snapshot(c));
}

// The weights a reference would give, from the formulas in double.
struct RefWeights {
  int64_t self, left, up, diagonal;
};

RefWeights reference_weights(double opacity, double fx, double fy) {
  const double o = std::floor(opacity * 256.0 + 0.5);
  RefWeights w;
  w.diagonal = static_cast<int64_t>(std::floor(o * fx * fy + 0.5));
  w.left = static_cast<int64_t>(std::floor(o * fx + 0.5)) - w.diagonal;
  w.up = static_cast<int64_t>(std::floor(o * fy + 0.5)) - w.diagonal;
  w.self = static_cast<int64_t>(o) - w.diagonal - w.left - w.up;
  return w;
}

// One white opaque texel over black: each of the four covered pixels shows its weight.
TEST(AlphaPicture, FractionalPlacementSplitsOneTexelIntoWeightsSummingToTheOpacity) {
  Loaded l = load(apic_test::alpha8(1, 1, {0x00FFFFFF}, {{0, 255}}));
  ASSERT_TRUE(l.pic);
  const double fractions[][2] = {{0.0, 0.0}, {0.25, 0.5}, {0.7, 0.1}, {0.5, 0.5}, {0.99, 0.37}};
  const float opacities[] = {1.0f, 0.5f, 0.3f, 0.01f};
  for (const auto& f : fractions) {
    for (float opacity : opacities) {
      MemoryRenderingBuffer buffer(4, 4, 0);
      l.pic->draw_at_faded(static_cast<float>(1.0 + f[0]), static_cast<float>(1.0 + f[1]), Size{4, 4}, buffer,
                           kAll, opacity);
      const RefWeights w = reference_weights(opacity, static_cast<float>(1.0 + f[0]) - 1.0,
                                             static_cast<float>(1.0 + f[1]) - 1.0);
      EXPECT_EQ(w.self + w.left + w.up + w.diagonal, static_cast<int64_t>(std::floor(opacity * 256.0 + 0.5)));
      const int64_t expected[4][4] = {
          {0, 0, 0, 0}, {0, w.self, w.left, 0}, {0, w.up, w.diagonal, 0}, {0, 0, 0, 0}};
      for (int32_t y = 0; y < 4; ++y) {
        for (int32_t x = 0; x < 4; ++x) {
          const int64_t level = (255 * 255 * expected[y][x]) >> 16;
          const uint32_t grey = static_cast<uint32_t>(level * 0x010101);
          EXPECT_EQ(buffer.pixel(x, y), grey) << f[0] << "," << f[1] << " opacity " << opacity << " at " << x << ","
                                              << y;
        }
      }
    }
  }
}

TEST(AlphaPicture, FractionalPlacementInsideAUniformPictureUsesTheWholeOpacity) {
  std::vector<std::pair<uint8_t, uint8_t>> pairs(25, {0, 200});
  Loaded l = load(apic_test::alpha8(5, 5, {0x00FF8000}, pairs));
  ASSERT_TRUE(l.pic);
  MemoryRenderingBuffer buffer(8, 8, 0x00204060);
  l.pic->draw_at_faded(1.3f, 1.8f, Size{8, 8}, buffer, kAll, 0.75f);
  const double o = 192;  // round(0.75 * 256)
  uint32_t want = 0;
  for (int c = 0; c < 3; ++c) {
    const double d = apic_test::byte_of(0x00204060, c);
    const double s = apic_test::byte_of(0x00FF8000, c);
    want |= static_cast<uint32_t>(d + std::floor((s - d) * 200 * o / 65536.0)) << (8 * c);
  }
  for (int32_t y = 3; y <= 5; ++y) {
    for (int32_t x = 2; x <= 5; ++x) EXPECT_EQ(buffer.pixel(x, y), want) << x << "," << y;
  }
  // The widened area ends one pixel past the picture; nothing beyond changes.
  for (int32_t y = 0; y < 8; ++y) {
    EXPECT_EQ(buffer.pixel(7, y), 0x00204060u);
    EXPECT_EQ(buffer.pixel(0, y), 0x00204060u);
  }
  EXPECT_NE(buffer.pixel(6, 6), 0x00204060u);
  EXPECT_EQ(buffer.pixel(3, 0), 0x00204060u);
}

TEST(AlphaPicture, FractionalPlacementKeepsToClipViewAndBuffer) {
  // A two-frame strip: frame 0 white, frame 1 black; showing frame 1 must not
  // bleed white into the rows shared by the sub-pixel spill.
  std::vector<std::pair<uint8_t, uint8_t>> pairs;
  for (int i = 0; i < 4; ++i) pairs.push_back({0, 255});
  for (int i = 0; i < 4; ++i) pairs.push_back({1, 255});
  Loaded l = load(apic_test::alpha8(2, 4, {0x00FFFFFF, 0x00000000}, pairs));
  ASSERT_TRUE(l.pic);
  const uint32_t fill = 0x00808080;
  MemoryRenderingBuffer buffer(6, 6, fill);
  // Frame 1 (rows 2..3) should land at buffer row 1.5.
  l.pic->draw_at(1.5f, -0.5f, Size{6, 6}, buffer, Rect{0, 2, 2, 4});
  for (int32_t y = 0; y < 6; ++y) {
    for (int32_t x = 0; x < 6; ++x) {
      const uint32_t p = buffer.pixel(x, y);
      EXPECT_LE(apic_test::byte_of(p, 0), 0x80) << x << "," << y;  // only darkening
      const bool touched = x >= 1 && x <= 3 && y >= 1 && y <= 3;
      if (!touched) {
        EXPECT_EQ(p, fill) << x << "," << y;
      }
    }
  }
  EXPECT_LT(apic_test::byte_of(buffer.pixel(2, 2), 0), 0x10);

  // A view smaller than the buffer (a repaint tile) limits the touched area.
  MemoryRenderingBuffer tile(6, 6, fill);
  l.pic->draw_at(0.5f, 0.5f, Size{2, 2}, tile, kAll);
  for (int32_t y = 0; y < 6; ++y) {
    for (int32_t x = 0; x < 6; ++x) {
      if (x >= 2 || y >= 2) {
        EXPECT_EQ(tile.pixel(x, y), fill) << x << "," << y;
      }
    }
  }
  EXPECT_NE(tile.pixel(1, 1), fill);

  // Off every edge of the buffer nothing is written out of bounds or wraps round.
  for (float x : {-3.5f, -1.25f, 5.75f, 7.0f}) {
    for (float y : {-4.5f, -0.75f, 5.5f}) {
      MemoryRenderingBuffer edge(6, 6, fill);
      l.pic->draw_at(x, y, Size{6, 6}, edge, kAll);
      for (int32_t by = 0; by < 6; ++by) {
        for (int32_t bx = 0; bx < 6; ++bx) {
          const bool near = bx >= std::floor(x) && bx <= std::floor(x) + 2 && by >= std::floor(y) &&
                            by <= std::floor(y) + 4;
          if (!near) {
            EXPECT_EQ(edge.pixel(bx, by), fill) << x << "," << y << " at " << bx << "," << by;
          }
        }
      }
    }
  }
}

TEST(AlphaPicture, WholePlacementOfTrueColourMatchesTheSameWeights) {
  std::vector<uint32_t> words = {0xFF102030, 0x80FFFFFF, 0x00123456, 0x40000000};
  Loaded l = load(apic_test::true_colour(1, 2, 2, words));
  ASSERT_TRUE(l.pic);
  const uint32_t fill = 0x00707070;
  MemoryRenderingBuffer buffer(4, 4, fill);
  l.pic->draw_at(1.0f, 1.0f, Size{4, 4}, buffer, kAll);
  for (int32_t y = 0; y < 2; ++y) {
    for (int32_t x = 0; x < 2; ++x) {
      const uint32_t s = words[y * 2 + x];
      const int32_t a = static_cast<int32_t>(s >> 24);
      uint32_t want = fill & 0xFF000000u;
      for (int c = 0; c < 3; ++c) {
        const double d = apic_test::byte_of(fill, c);
        want |= static_cast<uint32_t>(d + std::floor((apic_test::byte_of(s, c) - d) * a * 256 / 65536.0)) << (8 * c);
      }
      EXPECT_EQ(buffer.pixel(x + 1, y + 1), want) << x << "," << y;
    }
  }
}

// max(0, 1 - |t|): how much a texel at distance t from a sample counts.
double tent(double t) { return std::fabs(t) >= 1.0 ? 0.0 : 1.0 - std::fabs(t); }

TEST(AlphaPicture, RotatedSingleTexelSpreadsLikeABilinearSample) {
  Loaded l = load(apic_test::alpha8(1, 1, {0x00FFFFFF}, {{0, 255}}));
  ASSERT_TRUE(l.pic);
  const float angles[] = {0.0f, 0.3f, 0.785398f, 2.0f, -1.1f};
  const float centres[][2] = {{4.0f, 4.0f}, {4.25f, 3.5f}, {3.9f, 4.6f}};
  for (float angle : angles) {
    for (const auto& c : centres) {
      MemoryRenderingBuffer buffer(9, 9, 0);
      l.pic->draw_rotated(c[0], c[1], angle, buffer, kAll);
      double total = 0.0;
      for (int32_t y = 0; y < 9; ++y) {
        for (int32_t x = 0; x < 9; ++x) {
          // The texel sits at source (0, 0); the pixel samples the inverse rotation.
          const double dx = x - c[0];
          const double dy = y - c[1];
          const double sx = dx * std::cos(angle) - dy * std::sin(angle);
          const double sy = dx * std::sin(angle) + dy * std::cos(angle);
          const double weight = tent(sx) * tent(sy) * 256.0;
          const double want = 255.0 * 255.0 * weight / 65536.0;
          const double got = apic_test::byte_of(buffer.pixel(x, y), 1);
          // Fractions are taken in 1/256 steps and weights rounded: at most a couple of levels off.
          EXPECT_NEAR(got, want, 2.5) << "angle " << angle << " centre " << c[0] << "," << c[1] << " at " << x
                                      << "," << y;
          total += got;
        }
      }
      // Unturned, the samples split the texel's whole weight between them.
      if (angle == 0.0f) {
        EXPECT_NEAR(total, 255.0 * 255.0 * 256.0 / 65536.0, 4.0) << c[0] << "," << c[1];
      }
    }
  }
}

TEST(AlphaPicture, QuarterTurnOfAnAsymmetricPicture) {
  // 3 wide, 2 high, every texel a different colour, all opaque.
  std::vector<uint32_t> palette = {0x00FF0000, 0x0000FF00, 0x000000FF, 0x00FFFF00, 0x0000FFFF, 0x00FF00FF};
  std::vector<std::pair<uint8_t, uint8_t>> pairs;
  for (uint8_t i = 0; i < 6; ++i) pairs.push_back({i, 255});
  Loaded l = load(apic_test::alpha8(3, 2, palette, pairs));
  ASSERT_TRUE(l.pic);
  const uint32_t fill = 0x00000000;
  MemoryRenderingBuffer buffer(8, 8, fill);
  const float quarter = static_cast<float>(M_PI / 2.0);
  l.pic->draw_rotated(2.0f, 5.0f, quarter, buffer, kAll);
  // A counter-clockwise quarter turn on screen takes picture pixel (px, py) to (cx + py, cy - px).
  for (int32_t y = 0; y < 8; ++y) {
    for (int32_t x = 0; x < 8; ++x) {
      const int32_t py = x - 2;
      const int32_t px = 5 - y;
      uint32_t want = fill;
      if (px >= 0 && px < 3 && py >= 0 && py < 2) {
        const uint32_t s = palette[py * 3 + px];
        want = 0;
        for (int c = 0; c < 3; ++c) {
          want |= static_cast<uint32_t>(std::floor(apic_test::byte_of(s, c) * 255.0 * 256.0 / 65536.0)) << (8 * c);
        }
      }
      EXPECT_EQ(buffer.pixel(x, y), want) << x << "," << y;
    }
  }
}

TEST(AlphaPicture, RotationKeepsToTheClipAndFades) {
  std::vector<std::pair<uint8_t, uint8_t>> pairs(16, {0, 255});
  Loaded l = load(apic_test::alpha8(4, 4, {0x00FFFFFF}, pairs));
  ASSERT_TRUE(l.pic);
  MemoryRenderingBuffer clipped(10, 10, 0);
  const Rect clip{3, 2, 6, 5};
  l.pic->draw_rotated(2.5f, 2.5f, 0.4f, clipped, clip);
  MemoryRenderingBuffer whole(10, 10, 0);
  l.pic->draw_rotated(2.5f, 2.5f, 0.4f, whole, kAll);
  int changed = 0;
  for (int32_t y = 0; y < 10; ++y) {
    for (int32_t x = 0; x < 10; ++x) {
      const uint32_t want = clip.contains(x, y) ? whole.pixel(x, y) : 0u;
      EXPECT_EQ(clipped.pixel(x, y), want) << x << "," << y;
      changed += whole.pixel(x, y) != 0;
    }
  }
  EXPECT_GT(changed, 12);

  // Faded by half, a fully covered pixel moves half way (weights 128 of 256).
  MemoryRenderingBuffer faded(10, 10, 0);
  l.pic->draw_rotated_faded(2.0f, 2.0f, 0.0f, faded, kAll, 0.5f);
  const uint32_t level = static_cast<uint32_t>(std::floor(255.0 * 255.0 * 128.0 / 65536.0));
  EXPECT_EQ(faded.pixel(3, 3), level * 0x010101u);
  EXPECT_EQ(faded.pixel(6, 3), 0u);
  MemoryRenderingBuffer none(10, 10, 0);
  l.pic->draw_rotated_faded(2.0f, 2.0f, 0.3f, none, kAll, 0.0f);
  l.pic->draw_rotated(1e30f, 2.0f, 0.3f, none, kAll);
  l.pic->draw_rotated(2.0f, 2.0f, std::nanf(""), none, kAll);
  EXPECT_EQ(apic_test::snapshot(none), std::vector<uint32_t>(100, 0u));
}

}  // namespace
