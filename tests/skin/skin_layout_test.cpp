// The skin against the editor's layout: each control's pictures, placed by the
// generated anchors, land inside the control's hit rectangle and on its own panel;
// no two controls paint the same pixel; the knob scales printed on the backgrounds
// sit around the knobs; the knob frames point where their angle says.
#include <gtest/gtest.h>

#include <cmath>
#include <cstdio>
#include <string>
#include <vector>

#include "skin/skin_anchors.h"
#include "skin/skin_test_support.h"

namespace {

using guikit::Rect;
using skin_test::Footprint;
using skin_test::picture;

constexpr double kPi = 3.14159265358979323846;

struct Placed {
  std::string name;
  const SkinPictureGeometry* geometry;  // null: the picture's corner is the control position
  int dx = 0, dy = 0;                  // extra offset, e.g. the fader cap's travel
};

struct ControlCase {
  std::string what;
  int x, y;
  Rect hit;    // relative to the control position
  Rect panel;  // editor pixels of the background it sits on
  std::vector<Placed> pictures;
};

const Rect kMasterPanel{0, 0, 147, 229};
const Rect kTopPanel{147, 0, 609, 36};
const Rect kPresetsPanel{117, 229, 356, 282};
const Rect kInfoPanel{356, 229, 609, 282};
const int kBandLeft[4] = {147, 262, 376, 490};
const int kBandWidth[4] = {115, 114, 114, 119};

std::vector<Placed> frames(const char* stem, int count, const SkinPictureGeometry* g) {
  std::vector<Placed> out;
  for (int k = 0; k < count; ++k) {
    out.push_back({std::string(stem) + "_" + std::to_string(k), g});
  }
  return out;
}

std::vector<Placed> knob_pictures() {
  std::vector<Placed> out = {{"kn_26_p", &kSkinKnobBack}, {"kn_26_s", &kSkinKnobActive}};
  for (int i = 0; i < 97; ++i) {
    char name[16];
    std::snprintf(name, sizeof name, "kn_26_%02d", i);
    out.push_back({name, &kSkinKnobFrame});
  }
  return out;
}

ControlCase knob(const std::string& what, int x, int y, const Rect& panel) {
  return {what, x, y, Rect{-19, -19, 20, 23}, panel, knob_pictures()};
}

std::vector<ControlCase> all_controls() {
  std::vector<ControlCase> c;
  const Rect lamp_hit{-8, -8, 9, 9};
  c.push_back({"stereo boost", 112, 188, Rect{0, 0, 17, 17}, kMasterPanel, frames("ff_04", 5, &kSkinStereoSwitch)});
  std::vector<Placed> wide = frames("ff_16", 5, &kSkinWideSwitch);
  wide.push_back({"ff_16_p", &kSkinWideSwitchFront});
  c.push_back({"oversampling", 26, 8, Rect{-16, -5, 41, 28}, kMasterPanel, wide});
  c.push_back(knob("tone freq", 35, 72, kMasterPanel));
  c.push_back(knob("tone shape", 94, 72, kMasterPanel));
  c.push_back(knob("stereo phase", 35, 197, kMasterPanel));
  c.push_back(knob("feedback amount", 94, 135, kMasterPanel));
  c.push_back(knob("feedback freq", 35, 135, kMasterPanel));
  c.push_back(knob("master volume", 94, 22, kMasterPanel));
  c.push_back({"tone lamp", 68, 44, lamp_hit, kMasterPanel, frames("ff_18", 5, &kSkinLamp)});
  c.push_back({"boost lamp", 120, 169, lamp_hit, kMasterPanel, frames("ff_18", 5, &kSkinLamp)});
  c.push_back({"feedback lamp", 92, 107, lamp_hit, kMasterPanel, frames("ff_18", 5, &kSkinLamp)});
  c.push_back({"clip diode", 126, 20, Rect{-16, -5, 41, 28}, kMasterPanel, frames("ff_18", 5, &kSkinClipLamp)});
  for (int k = 0; k < 3; ++k) {
    std::vector<Placed> fader = {{"fd_09_s", &kSkinFaderTrack}};
    for (int travel : {0, 1, 218, 436, 437}) {
      fader.push_back({"fd_09", &kSkinFaderCap, travel, 0});
    }
    c.push_back({"split " + std::to_string(k), 162, 10 + 10 * k, Rect{-4, -3, 448, 4}, kTopPanel, fader});
  }
  const int solo_x[4] = {226, 340, 455, 569};
  for (int b = 0; b < 4; ++b) {
    const Rect panel{kBandLeft[b], 36, kBandLeft[b] + kBandWidth[b], 229};
    const int dx = 114 * b;
    const std::string band = "band " + std::to_string(b + 1) + " ";
    c.push_back(knob(band + "character", 177 + dx, 136, panel));
    c.push_back(knob(band + "intensity", 230 + dx, 136, panel));
    c.push_back(knob(band + "dist amount", 177 + dx, 197, panel));
    c.push_back(knob(band + "dist type", 230 + dx, 197, panel));
    c.push_back(knob(band + "volume", 230 + dx, 82, panel));
    c.push_back({band + "solo", solo_x[b], 39, Rect{-4, -3, 27, 15}, panel, frames("ff_17", 5, &kSkinSoloSwitch)});
    const std::string vn = "vn_0" + std::to_string(b + 1);
    c.push_back({band + "meter", 180 + dx, 118, Rect{-23, -59, 23, -22}, panel,
                 {{vn + "_p", &kSkinMeterFace}, {vn, &kSkinNeedle}, {vn + "_o", &kSkinMeterCover}}});
  }
  for (int i = 0; i < 8; ++i) {
    c.push_back({"program " + std::to_string(i), 117 + (i % 4) * 16 + 14, 229 + (i / 4 + 1) * 16,
                 Rect{0, 0, 13, 13}, kPresetsPanel, frames(("pb_" + std::to_string(11 + i)).c_str(), 5, nullptr)});
  }
  const Rect panel_lamp_hit{-15, -9, 16, 26};
  c.push_back({"load/store", 117 + 93, 229 + 22, panel_lamp_hit, kPresetsPanel, frames("ff_18", 5, &kSkinLamp)});
  c.push_back({"bank load", 117 + 184, 229 + 22, panel_lamp_hit, kPresetsPanel, frames("ff_18", 5, &kSkinLamp)});
  c.push_back({"bank save", 117 + 213, 229 + 22, panel_lamp_hit, kPresetsPanel, frames("ff_18", 5, &kSkinLamp)});
  std::vector<Placed> fade = {{"kn_08", &kSkinSmallKnob}};
  // The pointer rides 8 pixels from the knob's centre over the whole sweep.
  for (int step = 0; step <= 8; ++step) {
    const double a = 2 * kPi * (0.625 - 0.75 * step / 8.0);
    const double cx = kSkinSmallKnob.anchor_x + kSkinSmallKnob.pivot_x;
    const double cy = kSkinSmallKnob.anchor_y + kSkinSmallKnob.pivot_y;
    const int px = static_cast<int>(std::floor(cx + 8 * std::cos(a) - kSkinSmallKnobPointer.pivot_x + 0.5));
    const int py = static_cast<int>(std::floor(cy - 8 * std::sin(a) - kSkinSmallKnobPointer.pivot_y + 0.5));
    fade.push_back({"kn_08_spn", nullptr, px, py});
  }
  c.push_back({"fade time", 117 + 153, 229 + 31, Rect{-13, -14, 14, 13}, kPresetsPanel, fade});
  c.push_back({"setup", 356 + 181, 229 + 40, Rect{0, 0, 57, 14}, kInfoPanel, frames("pb_53", 2, nullptr)});
  return c;
}

Footprint footprint_of(const ControlCase& control) {
  Footprint fp;
  for (const Placed& p : control.pictures) {
    std::unique_ptr<guikit::PicDataInterface> pic = picture(p.name);
    EXPECT_NE(pic, nullptr) << p.name;
    if (!pic) continue;
    if (p.geometry != nullptr) {
      EXPECT_EQ(pic->get_width(), p.geometry->width) << p.name;
      EXPECT_EQ(pic->get_height(), p.geometry->height) << p.name;
    }
    const int ax = p.geometry != nullptr ? p.geometry->anchor_x : 0;
    const int ay = p.geometry != nullptr ? p.geometry->anchor_y : 0;
    fp.add(*pic, control.x + ax + p.dx, control.y + ay + p.dy);
  }
  return fp;
}

TEST(SkinLayout, EveryControlIsDrawnInsideItsHitRectangleOnItsPanel) {
  for (const ControlCase& control : all_controls()) {
    const Footprint fp = footprint_of(control);
    const Rect drawn = fp.bounds();
    ASSERT_FALSE(drawn.empty()) << control.what << " draws nothing";
    EXPECT_FALSE(fp.off_canvas()) << control.what << " draws far off the editor";
    const Rect hit{control.x + control.hit.left, control.y + control.hit.top, control.x + control.hit.right,
                   control.y + control.hit.bottom};
    EXPECT_TRUE(skin_test::inside(drawn, hit))
        << control.what << " draws (" << drawn.left << ", " << drawn.top << ", " << drawn.right << ", "
        << drawn.bottom << ") outside its hit rectangle (" << hit.left << ", " << hit.top << ", " << hit.right
        << ", " << hit.bottom << ")";
    EXPECT_TRUE(skin_test::inside(drawn, control.panel))
        << control.what << " spills off its panel: (" << drawn.left << ", " << drawn.top << ", " << drawn.right
        << ", " << drawn.bottom << ")";
  }
}

TEST(SkinLayout, NoTwoControlsPaintTheSamePixel) {
  const std::vector<ControlCase> controls = all_controls();
  std::vector<Footprint> prints;
  std::vector<Rect> bounds;
  for (const ControlCase& control : controls) {
    prints.push_back(footprint_of(control));
    bounds.push_back(prints.back().bounds());
  }
  for (size_t i = 0; i < controls.size(); ++i) {
    for (size_t j = i + 1; j < controls.size(); ++j) {
      const Rect overlap = bounds[i].intersect(bounds[j]);
      int shared = 0;
      for (int y = overlap.top; y < overlap.bottom; ++y) {
        for (int x = overlap.left; x < overlap.right; ++x) {
          shared += prints[i].touched(x, y) && prints[j].touched(x, y) ? 1 : 0;
        }
      }
      EXPECT_EQ(shared, 0) << controls[i].what << " and " << controls[j].what << " overlap";
    }
  }
}

// The editor surface with the band pages shown.
guikit::MemoryRenderingBuffer composed_backgrounds() {
  guikit::MemoryRenderingBuffer buffer(skin_test::kEditorWidth, skin_test::kEditorHeight, 0);
  for (const SkinBackground& b : kSkinBackgrounds) {
    if (std::string(b.name).find("tip") != std::string::npos) continue;
    std::unique_ptr<guikit::PicDataInterface> pic = picture(b.name);
    EXPECT_NE(pic, nullptr) << b.name;
    if (!pic) continue;
    pic->draw(guikit::view_for_position(b.left, b.top, {buffer.get_width(), buffer.get_height()}), buffer,
              Rect{0, 0, pic->get_width(), pic->get_height()});
  }
  return buffer;
}

int luminance(uint32_t p) { return (((p >> 16) & 255) * 3 + ((p >> 8) & 255) * 6 + (p & 255)) / 10; }

TEST(SkinLayout, BackgroundsTileTheWholeEditor) {
  guikit::MemoryRenderingBuffer white(skin_test::kEditorWidth, skin_test::kEditorHeight, 0x00FFFFFF);
  guikit::MemoryRenderingBuffer black = composed_backgrounds();
  for (const SkinBackground& b : kSkinBackgrounds) {
    if (std::string(b.name).find("tip") != std::string::npos) continue;
    picture(b.name)->draw(guikit::view_for_position(b.left, b.top, {white.get_width(), white.get_height()}), white,
                          Rect{0, 0, b.width, b.height});
  }
  int holes = 0;
  for (int y = 0; y < skin_test::kEditorHeight; ++y) {
    for (int x = 0; x < skin_test::kEditorWidth; ++x) {
      holes += (white.pixel(x, y) & 0xFFFFFF) != (black.pixel(x, y) & 0xFFFFFF) ? 1 : 0;
    }
  }
  EXPECT_EQ(holes, 0);
}

TEST(SkinLayout, KnobScalesSurroundTheKnobs) {
  const guikit::MemoryRenderingBuffer editor = composed_backgrounds();
  int knobs = 0;
  for (const ControlCase& control : all_controls()) {
    if (control.pictures.size() != 99) continue;  // the big knobs
    ++knobs;
    const double cx = control.x + kSkinKnobFrame.anchor_x + kSkinKnobFrame.pivot_x;
    const double cy = control.y + kSkinKnobFrame.anchor_y + kSkinKnobFrame.pivot_y;
    auto at = [&](double turns) {
      const double a = 2 * kPi * turns;
      return luminance(editor.pixel(static_cast<int>(std::floor(cx + 19 * std::cos(a))),
                                    static_cast<int>(std::floor(cy - 19 * std::sin(a)))));
    };
    // The end marks of the 270-degree sweep stand out; the gap at the bottom is bare panel.
    const int gap = at(0.75);
    EXPECT_GT(at(0.625), gap + 25) << control.what << " has no mark at its minimum";
    EXPECT_GT(at(-0.125), gap + 25) << control.what << " has no mark at its maximum";
  }
  EXPECT_EQ(knobs, 26);
}

TEST(SkinLayout, KnobFramesPointAlongTheirAngle) {
  for (int i : {0, 13, 24, 48, 60, 72, 96}) {
    char name[16];
    std::snprintf(name, sizeof name, "kn_26_%02d", i);
    std::unique_ptr<guikit::PicDataInterface> pic = picture(name);
    ASSERT_NE(pic, nullptr) << name;
    guikit::MemoryRenderingBuffer buffer(pic->get_width(), pic->get_height(), 0);
    pic->draw(guikit::view_for_position(0, 0, {buffer.get_width(), buffer.get_height()}), buffer,
              Rect{0, 0, pic->get_width(), pic->get_height()});
    // The pointer is the only near-white part of the knob.
    double sx = 0, sy = 0;
    int count = 0;
    for (int y = 0; y < buffer.get_height(); ++y) {
      for (int x = 0; x < buffer.get_width(); ++x) {
        const uint32_t p = buffer.pixel(x, y);
        if ((p & 255) > 200 && ((p >> 8) & 255) > 200 && ((p >> 16) & 255) > 200) {
          sx += x + 0.5 - kSkinKnobFrame.pivot_x;
          sy += y + 0.5 - kSkinKnobFrame.pivot_y;
          ++count;
        }
      }
    }
    ASSERT_GT(count, 5) << name;
    const double measured = std::atan2(-sy, sx);
    const double expected = 2 * kPi * (0.625 + i * -0.75773197 / 97);
    double diff = std::remainder(measured - expected, 2 * kPi);
    EXPECT_LT(std::fabs(diff), 8 * kPi / 180) << name;
  }
}

}  // namespace
