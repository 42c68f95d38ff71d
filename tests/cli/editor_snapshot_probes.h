// Probes of editor snapshots: whether the skin's backgrounds show where its
// anchors put them, and whether the "Tone Freq" knob at (35, 72) differs
// between two snapshots. Shared by the Linux and the Wine snapshot tests.
#pragma once

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "cli/editor_parent.h"
#include "skin/skin_anchors.h"
#include "skin/skin_test_support.h"

namespace snapshot_probe {

inline int channel_distance(uint32_t a, uint32_t b) {
  int largest = 0;
  for (int shift : {0, 8, 16}) {
    const int difference = static_cast<int>((a >> shift) & 255) - static_cast<int>((b >> shift) & 255);
    largest = std::max(largest, std::abs(difference));
  }
  return largest;
}

// A 24- or 32-bit uncompressed BMP, either row order.
inline plugcore::PixelImage read_bmp(const std::string& path) {
  FILE* file = std::fopen(path.c_str(), "rb");
  if (file == nullptr) throw std::runtime_error("cannot read " + path);
  std::vector<unsigned char> bytes;
  unsigned char chunk[4096];
  for (size_t got; (got = std::fread(chunk, 1, sizeof chunk, file)) > 0;) bytes.insert(bytes.end(), chunk, chunk + got);
  std::fclose(file);
  auto le = [&](size_t at, int count) {
    if (at + count > bytes.size()) throw std::runtime_error(path + " is cut short");
    uint32_t value = 0;
    for (int i = count - 1; i >= 0; --i) value = value << 8 | bytes[at + i];
    return value;
  };
  if (bytes.size() < 54 || bytes[0] != 'B' || bytes[1] != 'M') throw std::runtime_error(path + " is no BMP");
  const uint32_t offset = le(10, 4);
  const int32_t width = static_cast<int32_t>(le(18, 4));
  const int32_t raw_height = static_cast<int32_t>(le(22, 4));
  const int bits = static_cast<int>(le(28, 2));
  if ((bits != 24 && bits != 32) || le(30, 4) != 0 || width <= 0 || raw_height == 0) {
    throw std::runtime_error(path + ": only uncompressed 24- and 32-bit BMPs are read");
  }
  const int height = std::abs(raw_height);
  const size_t row = (static_cast<size_t>(width) * (bits / 8) + 3) & ~size_t{3};
  plugcore::PixelImage image;
  image.width = width;
  image.height = height;
  image.pixels.resize(static_cast<size_t>(width) * height);
  for (int y = 0; y < height; ++y) {
    const int file_row = raw_height > 0 ? height - 1 - y : y;
    for (int x = 0; x < width; ++x) {
      image.pixels[static_cast<size_t>(y) * width + x] = le(offset + file_row * row + x * (bits / 8), 3);
    }
  }
  return image;
}

// The master and top backgrounds drawn where the anchors put them.
inline guikit::MemoryRenderingBuffer fixed_backgrounds() {
  guikit::MemoryRenderingBuffer skin(skin_test::kEditorWidth, skin_test::kEditorHeight, 0);
  for (const SkinBackground& b : kSkinBackgrounds) {
    const std::string name = b.name;
    if (name != "bkg_24_master" && name != "bkg_24_top") continue;
    std::unique_ptr<guikit::PicDataInterface> pic = skin_test::picture(name);
    if (!pic) throw std::runtime_error("no skin picture " + name);
    pic->draw(guikit::view_for_position(b.left, b.top, {skin.get_width(), skin.get_height()}), skin,
              guikit::Rect{0, 0, pic->get_width(), pic->get_height()});
  }
  return skin;
}

// Share of a background's pixels the snapshot shows unchanged; controls
// cover the rest.
inline double background_share(const plugcore::PixelImage& image, const guikit::MemoryRenderingBuffer& skin,
                               const SkinBackground& background) {
  long same = 0;
  long all = 0;
  for (int y = background.top; y < background.top + background.height; ++y) {
    for (int x = background.left; x < background.left + background.width; ++x) {
      if (x >= image.width || y >= image.height) continue;
      ++all;
      same += channel_distance(image.at(x, y), skin.pixel(x, y) & 0x00FFFFFFu) <= 2 ? 1 : 0;
    }
  }
  return all == 0 ? 0.0 : static_cast<double>(same) / all;
}

// Pixels of the knob at (35, 72) that differ between the two snapshots.
inline int tone_knob_changes(const plugcore::PixelImage& a, const plugcore::PixelImage& b) {
  int changed = 0;
  for (int y = 72 - kSkinKnobFrame.height / 2; y <= 72 + kSkinKnobFrame.height / 2; ++y) {
    for (int x = 35 - kSkinKnobFrame.width / 2; x <= 35 + kSkinKnobFrame.width / 2; ++x) {
      changed += channel_distance(a.at(x, y), b.at(x, y)) > 8 ? 1 : 0;
    }
  }
  return changed;
}

// Every probe on the snapshots of the default state and of program 5;
// tone_moved tells whether program 5 sets another "Tone Freq" value.
inline void expect_snapshots_show_state(const plugcore::PixelImage& base, const plugcore::PixelImage& five,
                                        bool tone_moved, const std::string& what) {
  ASSERT_EQ(base.width, skin_test::kEditorWidth) << what;
  ASSERT_EQ(base.height, skin_test::kEditorHeight) << what;
  ASSERT_EQ(five.width, base.width) << what;
  ASSERT_EQ(five.height, base.height) << what;
  const guikit::MemoryRenderingBuffer skin = fixed_backgrounds();
  for (const SkinBackground& b : kSkinBackgrounds) {
    const std::string name = b.name;
    if (name != "bkg_24_master" && name != "bkg_24_top") continue;
    EXPECT_GT(background_share(base, skin, b), 0.5) << name << " in the default snapshot, " << what;
    EXPECT_GT(background_share(five, skin, b), 0.5) << name << " in the program 5 snapshot, " << what;
  }
  const int changed = tone_knob_changes(base, five);
  if (tone_moved) {
    EXPECT_GT(changed, 10) << "the Tone Freq knob looks the same, " << what;
  } else {
    EXPECT_EQ(changed, 0) << "Tone Freq is the same in both, yet its knob changed, " << what;
  }
}

}  // namespace snapshot_probe
