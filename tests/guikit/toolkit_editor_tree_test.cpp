#include <gtest/gtest.h>

#include "controls_test_support.h"
#include "guikit/background_item.h"
#include "guikit/knob.h"
#include "guikit/push_button.h"

using namespace guikit;
using guikit_test::RecordingListener;
using guikit_test::SolidPicture;

namespace {

// Two background panels side by side and a control tree split the same way,
// painted in tiles smaller than either panel.
struct EditorTree {
  OffscreenWindow window{Size{100, 40}, Size{30, 16}};
  SolidPicture left_panel{60, 40, 0x00202020};
  SolidPicture right_panel{40, 40, 0x00404040};
  BackgroundSplit background{true};
  BackgroundItem left{left_panel.pic.get()};
  BackgroundItem right{right_panel.pic.get()};
  CtrlGroupSplit controls{true};
  CtrlGroupItem left_group, right_group;

  EditorTree() {
    background.add_child(&left, 60);
    background.add_child(&right, 40);
    controls.add_child(&left_group, 60);
    controls.add_child(&right_group, 40);
    background.set_position(Point{0, 0});
    controls.set_position(Point{0, 0});
    controls.set_parent(&window);
    background.set_parent(&window);
    window.set_roots(&background, &controls);
    ShowObject show(true);
    background.process_message(show);
    controls.process_message(show);
  }
};

class CountingMgr : public MiscMgrInterface {
 public:
  void on_value(double value, int32_t origin) override { values.push_back(value); }
  void on_before_message(MessageInterface&) override { ++before; }
  void on_after_message(MessageInterface&) override { ++after; }
  void set_owner(DefaultEventListener* owner) override { this->owner = owner; }
  std::vector<double> values;
  int before = 0;
  int after = 0;
  DefaultEventListener* owner = nullptr;
};

}  // namespace

TEST(ToolkitEditorTree, BackgroundsAndControlsPaintAcrossTilesAndSplits) {
  EditorTree t;
  SolidPicture face(10, 10, 0x00A0B0C0);
  PushButton button;
  button.set_frames({face.at(0, 0), face.at(0, 0)});
  button.set_offset(Point{5, 5});  // inside the right group, which starts at x = 60
  button.set_bounding_box(Rect{0, 0, 10, 10});
  button.set_placed(true);
  t.right_group.add_control(&button);
  EXPECT_EQ(65, button.get_position().x);

  t.window.paint_all();
  EXPECT_EQ(12, t.window.get_tile_count()) << "4 columns of 30, 3 rows of 16";
  EXPECT_EQ(0x00202020u, t.window.pixel(0, 0));
  EXPECT_EQ(0x00202020u, t.window.pixel(59, 39));
  EXPECT_EQ(0x00404040u, t.window.pixel(60, 0));
  EXPECT_EQ(0x00404040u, t.window.pixel(99, 39));
  EXPECT_EQ(0x00A0B0C0u, t.window.pixel(65, 5));
  EXPECT_EQ(0x00A0B0C0u, t.window.pixel(74, 14)) << "the last row and column of the face";
  EXPECT_EQ(0x00A0B0C0u, t.window.pixel(69, 14));
  EXPECT_EQ(0x00404040u, t.window.pixel(75, 15));
}

TEST(ToolkitEditorTree, ClicksFindTheirControlThroughTheSplitsAndListenersForward) {
  EditorTree t;
  PushButton a, b;
  RecordingListener ra;
  DefaultEventListener forwarding;
  CountingMgr mgr;
  forwarding.set_next(&mgr);
  EXPECT_EQ(&forwarding, mgr.owner);
  a.set_listener(&ra);
  b.set_listener(&forwarding);
  a.set_bounding_box(Rect{0, 0, 20, 20});
  b.set_bounding_box(Rect{0, 0, 20, 20});
  t.left_group.add_control(&a);
  b.set_offset(Point{10, 10});
  t.right_group.add_control(&b);

  t.window.click_at(75, 15);
  EXPECT_EQ(0, ra.clicks);
  EXPECT_GE(mgr.before, 2) << "the click and the timer request passed the listener";
  EXPECT_EQ(mgr.before, mgr.after);
  t.window.button_up();
  t.window.click_at(5, 5);
  EXPECT_EQ(1, ra.clicks);

  b.set_value_by_user(0.7, kOriginMouse);
  EXPECT_EQ(std::vector<double>{0.7}, mgr.values);
}

TEST(ToolkitEditorTree, KnobLayersFollowItsStateAndOpacity) {
  OffscreenWindow window{Size{40, 40}};
  CtrlGroupItem group;
  group.set_parent(&window);
  group.set_position(Point{0, 0});
  window.set_roots(nullptr, &group);
  ShowObject show(true);
  group.process_message(show);

  SolidPicture face(20, 20, 0x00000000);
  SolidPicture active(20, 20, 0x000000F0, 255, true);
  SolidPicture glow(20, 20, 0x00F00000, 255, true);
  Knob k;
  PotBehaviour::set_mouse_compatibility(0);
  k.set_background(face.at(0, 0));
  k.set_active_picture(active.at(0, 0));
  k.set_highlight_picture(glow.at(0, 0));
  k.set_bounding_box(Rect{0, 0, 20, 20});
  k.set_placed(true);
  group.add_control(&k);

  window.paint_all();
  EXPECT_EQ(0u, window.pixel(10, 10) & 0x00FFFFFF);
  k.set_highlight(true);
  window.paint_pending();
  EXPECT_GT(guikit_test::red_of(window.pixel(10, 10)), 200u) << "highlighted";
  k.set_highlight(false);
  window.click_at(10, 5);
  window.paint_pending();
  EXPECT_GT(window.pixel(10, 10) & 0xFF, 200u) << "active while the click lasts";
  EXPECT_LT(guikit_test::red_of(window.pixel(10, 10)), 10u);
  window.button_up();
  window.advance_ms(500);
  window.paint_all();
  EXPECT_LT(window.pixel(10, 10) & 0xFF, 10u) << "the gesture ended";

  // Half opacity: a faded layer lands between the face and its colour.
  k.set_highlight(true);
  k.set_opacity(0.5f);
  window.paint_all();
  uint32_t red = guikit_test::red_of(window.pixel(10, 10));
  EXPECT_GT(red, 90u);
  EXPECT_LT(red, 150u);
}
