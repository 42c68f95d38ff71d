#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include "guikit/alpha_pic_data8.h"
#include "guikit/control_interface.h"
#include "guikit/ctrl_group_item.h"
#include "guikit/default_event_listener.h"
#include "guikit/headless/offscreen_window.h"
#include "guikit/pic_data8.h"

namespace guikit_test {

// A one-colour picture built by hand: opaque, or with opacity bytes.
struct SolidPicture {
  SolidPicture(int32_t w, int32_t h, uint32_t bgr, uint8_t alpha = 255, bool with_alpha = false)
      : palette{static_cast<uint8_t>(bgr), static_cast<uint8_t>(bgr >> 8), static_cast<uint8_t>(bgr >> 16), 0} {
    if (with_alpha) {
      for (int32_t i = 0; i < w * h; ++i) {
        bytes.push_back(0);
        bytes.push_back(alpha);
      }
      pic = std::make_unique<guikit::AlphaPicData8>(guikit::Size{w, h}, bytes.data(), palette.data());
    } else {
      bytes.assign(static_cast<size_t>(w * h), 0);
      pic = std::make_unique<guikit::PicData8>(guikit::Size{w, h}, bytes.data(), palette.data());
    }
  }
  guikit::Picture at(int32_t x, int32_t y) { return guikit::Picture(pic.get(), guikit::Point{x, y}); }

  std::vector<uint8_t> palette;
  std::vector<uint8_t> bytes;
  std::unique_ptr<guikit::PicDataInterface> pic;
};

struct Change {
  double value;
  int32_t origin;
};

// Records the protocol; can veto after a number of allowed changes.
class RecordingListener : public guikit::DefaultEventListener {
 public:
  bool can_change(int32_t origin) override {
    ++asked;
    if (allow_left == 0) return false;
    if (allow_left > 0) --allow_left;
    return true;
  }
  double value_changed(double value, int32_t origin) override {
    changes.push_back(Change{value, origin});
    return guikit::DefaultEventListener::value_changed(value, origin);
  }
  void clicked() override { ++clicks; }
  void released() override { ++releases; }
  void hold_change(int32_t) override { ++holds; }
  void end_change(int32_t origin) override { ends.push_back(origin); }
  void on_event(int32_t code, int32_t argument) override { events.push_back(code); }

  int allow_left = -1;  // -1: always allow
  int asked = 0;
  int clicks = 0;
  int releases = 0;
  int holds = 0;
  std::vector<int32_t> ends;
  std::vector<int32_t> events;
  std::vector<Change> changes;
};

// An off-screen window with one visible control group at the origin.
struct Stage {
  explicit Stage(guikit::Size size = guikit::Size{300, 300}) : window(size) {
    group.set_parent(&window);
    group.set_position(guikit::Point{0, 0});
    window.set_roots(nullptr, &group);
    guikit::ShowObject show(true);
    group.process_message(show);
  }
  void add(guikit::ControlInterface& c, guikit::Point offset, guikit::Rect box) {
    c.set_offset(offset);
    c.set_bounding_box(box);
    c.set_placed(true);
    group.add_control(&c);
  }
  guikit::OffscreenWindow window;
  guikit::CtrlGroupItem group;
};

inline uint32_t red_of(uint32_t px) { return (px >> 16) & 0xFF; }

}  // namespace guikit_test
