#include <gtest/gtest.h>

#include <stdexcept>

#include "controls_test_support.h"
#include "guikit/ctrl_group_item.h"

using namespace guikit;
using guikit_test::RecordingListener;
using guikit_test::Stage;

namespace {

// Answers with its own code so tests see which control a message reached.
class TaggedControl : public ControlInterface {
 public:
  explicit TaggedControl(int32_t tag) : tag_(tag) {}
  int32_t on_mouse_move(MouseMove&) override { return tag_; }
  int32_t on_mouse_click(MouseClick&) override { return tag_; }
  int32_t on_redraw(Redraw&) override {
    ++redraws;
    return tag_;
  }
  void stop() override { ++stops; }
  int redraws = 0;
  int stops = 0;

 private:
  int32_t tag_;
};

// Runs a listener-list operation from inside a callback of the control.
class MeddlingListener : public DefaultEventListener {
 public:
  enum What { kNone, kRemoveInValueChanged, kSetInBeforeMessage, kPushInCanChange };
  double value_changed(double value, int32_t origin) override {
    if (what == kRemoveInValueChanged) attempt([&] { get_control()->remove_listener(this); });
    return value * 2.0;
  }
  void before_message(MessageInterface&) override {
    if (what == kSetInBeforeMessage) attempt([&] { get_control()->set_listener(nullptr); });
  }
  bool can_change(int32_t) override {
    if (what == kPushInCanChange) attempt([&] { get_control()->push_back_listener(this); });
    return true;
  }
  template <class F>
  void attempt(F f) {
    try {
      f();
    } catch (const std::runtime_error& e) {
      error = e.what();
    }
  }
  What what = kNone;
  std::string error;
};

class HalfFilter : public DefaultEventListener {
 public:
  double filter_user_value(double value, int32_t) override { return value * 0.5; }
  double filter_set_value(double value, int32_t) override { return value + 0.25; }
};

}  // namespace

TEST(ControlsRouting, APointReachesOnlyTheFirstOfOverlappingControls) {
  Stage s;
  TaggedControl first(11), second(22), apart(33);
  s.add(first, Point{10, 10}, Rect{0, 0, 50, 50});
  s.add(second, Point{30, 30}, Rect{0, 0, 50, 50});
  s.add(apart, Point{200, 0}, Rect{0, 0, 10, 10});
  MouseMove overlap(40, 40);
  EXPECT_EQ(11, s.group.process_message(overlap));
  MouseMove only_second(70, 70);
  EXPECT_EQ(22, s.group.process_message(only_second));
  MouseMove edge(60, 60);  // first ends at 60 (exclusive)
  EXPECT_EQ(22, s.group.process_message(edge));
  MouseMove nothing(150, 150);
  EXPECT_EQ(-1, s.group.process_message(nothing));
}

TEST(ControlsRouting, AnAreaReachesEveryControlItOverlaps) {
  Stage s;
  TaggedControl a(1), b(2), c(3);
  s.add(a, Point{0, 0}, Rect{0, 0, 20, 20});
  s.add(b, Point{20, 0}, Rect{0, 0, 20, 20});
  s.add(c, Point{100, 100}, Rect{0, 0, 20, 20});
  MemoryRenderingBuffer buffer(64, 64);
  Redraw r(Rect{10, 5, 21, 6}, buffer);
  EXPECT_EQ(2, s.group.process_message(r)) << "the answer of the last control reached";
  EXPECT_EQ(1, a.redraws);
  EXPECT_EQ(1, b.redraws);
  EXPECT_EQ(0, c.redraws);
  Redraw touching(Rect{40, 0, 60, 20}, buffer);  // starts where b ends
  EXPECT_EQ(0, s.group.process_message(touching));
  EXPECT_EQ(1, b.redraws);
}

TEST(ControlsRouting, GroupsPlaceTheirControlsAndPassVisibility) {
  CtrlGroupSplit root(true);
  CtrlGroupItem left, right;
  TaggedControl c(1);
  c.set_offset(Point{5, 6});
  right.add_control(&c);
  EXPECT_FALSE(c.is_visible()) << "a hidden group hides what it is given";
  root.add_child(&left, 100);
  root.add_child(&right, 100);
  root.set_position(Point{10, 20});
  EXPECT_EQ(115, c.get_position().x);
  EXPECT_EQ(26, c.get_position().y);
  ShowObject show(true);
  root.process_message(show);
  EXPECT_TRUE(c.is_visible());
  int stops_before = c.stops;
  EXPECT_EQ(0, right.remove_control(&c));
  EXPECT_FALSE(c.is_visible());
  EXPECT_EQ(stops_before + 1, c.stops) << "a control that becomes invisible stops";
  EXPECT_EQ(nullptr, c.get_group());
  EXPECT_EQ(-1, right.remove_control(&c));
}

TEST(ControlsRouting, InvalidateSelfSendsTheAbsoluteBoxOnlyWhenPlaced) {
  Stage s;
  TaggedControl c(1);
  s.add(c, Point{40, 50}, Rect{-2, -3, 10, 12});
  c.set_placed(false);
  EXPECT_EQ(0, c.invalidate_self());
  EXPECT_TRUE(s.window.get_invalidated().empty());
  c.set_placed(true);
  EXPECT_EQ(0, c.invalidate_self());
  ASSERT_EQ(1u, s.window.get_invalidated().size());
  EXPECT_EQ((Rect{38, 47, 50, 62}), s.window.get_invalidated()[0]);
}

TEST(ControlsProtocol, FiltersThenValueChangedChainAndAVetoChangesNothing) {
  TaggedControl c(1);
  HalfFilter filter;
  RecordingListener rec;
  MeddlingListener doubler;
  c.push_back_listener(&filter);
  c.push_back_listener(&doubler);
  c.push_back_listener(&rec);
  EXPECT_EQ(&c, rec.get_control());
  EXPECT_TRUE(c.set_value_by_user(0.8, kOriginMouse));
  // 0.8 halved by the filter, doubled by the second listener's value_changed.
  EXPECT_DOUBLE_EQ(0.8, c.get_value());
  ASSERT_EQ(1u, rec.changes.size());
  EXPECT_DOUBLE_EQ(0.8, rec.changes[0].value);
  EXPECT_TRUE(c.set_value(0.25, kOriginSync));
  EXPECT_DOUBLE_EQ(1.0, c.get_value()) << "(0.25 + 0.25) doubled";
  rec.allow_left = 0;
  EXPECT_FALSE(c.set_value_by_user(0.1, kOriginMouse));
  EXPECT_DOUBLE_EQ(1.0, c.get_value());
  EXPECT_EQ(2u, rec.changes.size());
}

TEST(ControlsProtocol, ListenerListsRefuseChangesWhileBusyWithTheExactTexts) {
  TaggedControl c(1);
  MeddlingListener m;
  c.push_back_listener(&m);
  m.what = MeddlingListener::kRemoveInValueChanged;
  c.set_value_by_user(0.5, kOriginMouse);
  EXPECT_EQ("guikit::ControlInterface::remove_listener() : Recursive call.", m.error);
  EXPECT_EQ(1u, c.get_listener_count()) << "the refused call changed nothing";

  m.error.clear();
  m.what = MeddlingListener::kSetInBeforeMessage;
  MouseMove move(0, 0);
  c.process_message(move);
  EXPECT_EQ("guikit::ControlInterface::set_listener() : Recursive call.", m.error);
  EXPECT_EQ(&m, c.get_first_listener());

  m.error.clear();
  m.what = MeddlingListener::kPushInCanChange;
  c.set_value(0.5, 0);
  EXPECT_EQ("guikit::ControlInterface::push_back_listener() : Recursive call.", m.error);
  EXPECT_EQ(1u, c.get_listener_count());
  EXPECT_FALSE(c.is_busy());

  // Outside any callback the same operations work.
  m.what = MeddlingListener::kNone;
  c.add_unique_listener(&m);
  c.push_back_listener(&m);
  EXPECT_EQ(2u, c.get_listener_count());
  c.remove_listener(&m);
  EXPECT_EQ(0u, c.get_listener_count());
}

TEST(ControlsProtocol, ClicksOnHiddenControlsAreNotReportedAndGesturesEnd) {
  TaggedControl c(1);
  RecordingListener rec;
  c.set_listener(&rec);
  ShowObject hide(false);
  c.process_message(hide);
  MouseClick down(0, 0, kButtonLeft, 0, 0);
  c.process_message(down);
  EXPECT_EQ(0, rec.clicks);
  EXPECT_FALSE(c.is_active());
  ShowObject show(true);
  c.process_message(show);
  c.process_message(down);
  EXPECT_EQ(1, rec.clicks);
  EXPECT_TRUE(c.is_active());
  c.end_gesture();
  EXPECT_EQ(1, rec.releases);
  EXPECT_FALSE(c.is_active());
}

TEST(ControlsProtocol, MarkersAreDrawnAfterTheControlAtItsPosition) {
  Stage s(Size{60, 60});
  guikit_test::SolidPicture mark(2, 2, 0x00FF0000);
  TaggedControl c(1);
  s.add(c, Point{20, 30}, Rect{0, 0, 10, 10});
  c.set_markers({mark.at(3, 4)});
  s.window.paint_all();
  EXPECT_EQ(0u, s.window.pixel(23, 34));
  c.set_marker(0);
  EXPECT_FALSE(s.window.get_invalidated().empty());
  s.window.paint_all();
  EXPECT_EQ(0x00FF0000u, s.window.pixel(23, 34));
  EXPECT_EQ(0x00FF0000u, s.window.pixel(24, 35));
  EXPECT_EQ(0u, s.window.pixel(25, 36));
  c.set_marker(5);  // no such marker: nothing drawn
  s.window.paint_all();
}
