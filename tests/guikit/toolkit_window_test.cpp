#include <gtest/gtest.h>

#include <thread>

#include "guikit/headless/offscreen_window.h"
#include "guikit/sp_tree_node.h"
#include "guikit/toolkit_clock.h"
#include "toolkit_recording_node.h"

using namespace guikit;
using guikit_test::Delivery;
using guikit_test::RecordingHandler;
using guikit_test::RecordingNode;

namespace {

int count_kind(const std::vector<Delivery>& log, const std::string& node, const std::string& kind) {
  int n = 0;
  for (const auto& d : log) n += (d.node == node && d.kind == kind) ? 1 : 0;
  return n;
}

// Times of the Notify messages a handler received.
class TimerSink : public MessageHandlerInterface {
 public:
  int32_t process_message(MessageInterface& m) override {
    if (auto* n = dynamic_cast<Notify*>(&m)) {
      times.push_back(n->time);
      ids.push_back(n->timer_id);
      if (window && clear_on_tick == static_cast<int>(times.size())) {
        ClearTimer clear(n->timer_id);
        window->process_message(clear);
      }
    }
    return 0;
  }
  std::vector<double> times;
  std::vector<int32_t> ids;
  WindowInterface* window = nullptr;
  int clear_on_tick = 0;
};

}  // namespace

TEST(ToolkitWindow, InvalidateIsClampedToTheEditor) {
  OffscreenWindow w(Size{200, 100});
  Invalidate a(Rect{-20, -5, 50, 40});
  EXPECT_EQ(0, w.process_message(a));
  Invalidate b(Rect{150, 90, 400, 300});
  EXPECT_EQ(0, w.process_message(b));
  ASSERT_EQ(2u, w.get_invalidated().size());
  EXPECT_EQ((Rect{0, 0, 50, 40}), w.get_invalidated()[0]);
  EXPECT_EQ((Rect{150, 90, 200, 100}), w.get_invalidated()[1]);
}

TEST(ToolkitWindow, OnlyUpwardMessagesOfAnOpenWindowAreCarriedOut) {
  OffscreenWindow w(Size{20, 20});
  MouseMove down(1, 1);
  EXPECT_EQ(-1, w.process_message(down));
  MessageUp unknown;
  EXPECT_EQ(-1, w.process_message(unknown));
  w.close();
  Invalidate inv(Rect{0, 0, 5, 5});
  EXPECT_EQ(-1, w.process_message(inv));
  EXPECT_TRUE(w.get_invalidated().empty());
}

TEST(ToolkitWindow, RepaintGoesTileByTileColumnsFirstBackgroundBeforeControls) {
  std::vector<Delivery> log;
  OffscreenWindow w(Size{100, 60}, Size{40, 25});
  RecordingNode background{"bg", &log, 0x00123456};
  RecordingNode controls{"ctl", &log};
  w.set_roots(&background, &controls);
  w.paint(Rect{10, 5, 95, 55});

  std::vector<Rect> expected = {Rect{10, 5, 50, 30},  Rect{10, 30, 50, 55}, Rect{50, 5, 90, 30},
                                Rect{50, 30, 90, 55}, Rect{90, 5, 95, 30},  Rect{90, 30, 95, 55}};
  ASSERT_EQ(expected.size() * 2, log.size());
  for (size_t i = 0; i < expected.size(); ++i) {
    EXPECT_EQ("bg", log[2 * i].node);
    EXPECT_EQ("ctl", log[2 * i + 1].node);
    EXPECT_EQ(expected[i], log[2 * i].area) << "tile " << i;
    EXPECT_EQ(expected[i], log[2 * i + 1].area) << "tile " << i;
  }
  EXPECT_EQ(6, w.get_tile_count());
  // Each tile landed where it belongs: the painter's pattern encodes the editor pixel.
  for (int32_t y = 0; y < 60; y += 7) {
    for (int32_t x = 0; x < 100; x += 9) {
      bool inside = x >= 10 && x < 95 && y >= 5 && y < 55;
      uint32_t want = inside ? (0x00123456u ^ static_cast<uint32_t>((x << 8) | y)) : 0u;
      EXPECT_EQ(want, w.pixel(x, y)) << x << "," << y;
    }
  }
}

TEST(ToolkitWindow, RepaintIsClippedToTheEditorAndPendingAreasAreUnited) {
  std::vector<Delivery> log;
  OffscreenWindow w(Size{50, 40});
  RecordingNode background{"bg", &log};
  w.set_roots(&background, nullptr);
  w.set_window_size(Size{80, 70});
  w.paint_all();
  ASSERT_EQ(1u, log.size());
  EXPECT_EQ((Rect{0, 0, 50, 40}), log[0].area);

  log.clear();
  Invalidate a(Rect{2, 3, 10, 10});
  Invalidate b(Rect{20, 1, 30, 5});
  w.process_message(a);
  w.process_message(b);
  w.paint_pending();
  ASSERT_EQ(1u, log.size());
  EXPECT_EQ((Rect{2, 1, 30, 10}), log[0].area);
  log.clear();
  w.paint_pending();
  EXPECT_TRUE(log.empty()) << "nothing is pending after a paint";
}

TEST(ToolkitWindow, MouseGoesToTheControlRootUnlessCaptured) {
  std::vector<Delivery> log;
  OffscreenWindow w(Size{100, 100});
  RecordingNode controls{"ctl", &log};
  RecordingHandler grabber(&log, "grab");
  w.mouse_move(5, 5);  // no root yet: dropped
  EXPECT_TRUE(log.empty());
  w.set_roots(nullptr, &controls);
  w.mouse_move(10, 12);
  w.button_down(kButtonRight, kModShift);
  ASSERT_EQ(2u, log.size());
  EXPECT_EQ("move", log[0].kind);
  EXPECT_EQ((Rect{10, 12, 10, 12}), log[0].area);
  EXPECT_EQ("click", log[1].kind);

  MouseCapture cap(0, &grabber);
  EXPECT_EQ(0, w.process_message(cap));
  EXPECT_FALSE(w.is_cursor_hidden()) << "mode 0 keeps the cursor";
  log.clear();
  w.mouse_move(30, 40);
  ASSERT_EQ(1u, log.size());
  EXPECT_EQ("grab", log[0].node);
  EXPECT_EQ((Rect{30, 40, 30, 40}), log[0].area) << "mode 0 reports positions";
}

TEST(ToolkitWindow, CaptureMovesBetweenHandlersAndItsLossIsReported) {
  std::vector<Delivery> log;
  OffscreenWindow w(Size{100, 100});
  RecordingNode controls{"ctl", &log};
  RecordingHandler first(&log, "first");
  RecordingHandler second(&log, "second");
  w.set_roots(nullptr, &controls);
  w.mouse_move(40, 40);

  MouseCapture a(2, &first);
  EXPECT_EQ(0, w.process_message(a));
  EXPECT_TRUE(w.is_cursor_hidden());
  MouseCapture again(2, &first);
  EXPECT_EQ(0, w.process_message(again));
  EXPECT_EQ(0, count_kind(log, "first", "lost")) << "the same handler keeps its capture silently";

  MouseCapture b(1, &second);
  EXPECT_EQ(0, w.process_message(b));
  EXPECT_EQ(1, count_kind(log, "first", "lost"));
  EXPECT_EQ(&second, w.core().get_capture_handler());
  EXPECT_TRUE(w.is_cursor_hidden()) << "hidden once, not twice";

  w.lose_capture();
  EXPECT_EQ(1, count_kind(log, "second", "lost"));
  EXPECT_FALSE(w.is_cursor_hidden());
  EXPECT_EQ(nullptr, w.core().get_capture_handler());
  log.clear();
  w.mouse_move(41, 41);
  ASSERT_EQ(1u, log.size());
  EXPECT_EQ("ctl", log[0].node) << "after the loss the mouse goes to the tree again";
}

TEST(ToolkitWindow, ARefusedCaptureAnswersMinusOneAndKeepsThePreviousState) {
  std::vector<Delivery> log;
  OffscreenWindow w(Size{100, 100});
  RecordingHandler h(&log);
  w.refuse_capture(true);
  MouseCapture cap(2, &h);
  EXPECT_EQ(-1, w.process_message(cap));
  EXPECT_EQ(nullptr, w.core().get_capture_handler());
  EXPECT_FALSE(w.is_cursor_hidden());
}

TEST(ToolkitWindow, RelativeModeReportsMovementAndWarpsBackToTheAnchor) {
  std::vector<Delivery> log;
  OffscreenWindow w(Size{300, 300});
  RecordingHandler h(&log);
  w.mouse_move(100, 100);
  MouseCapture cap(2, &h);
  ASSERT_EQ(0, w.process_message(cap));

  w.mouse_move(103, 95);
  ASSERT_EQ(1u, log.size());
  EXPECT_EQ((Rect{3, -5, 3, -5}), log[0].area);
  EXPECT_EQ(103, w.get_cursor().x) << "no warp before the capture settled";

  w.advance_ms(260);
  w.mouse_move(110, 90);
  EXPECT_EQ((Rect{7, -5, 7, -5}), log[1].area);
  EXPECT_EQ(100, w.get_cursor().x) << "warped to the anchor";
  EXPECT_EQ(100, w.get_cursor().y);

  // Less than 100 ms after the warp the cursor stays; the movement counts from the anchor.
  w.advance_ms(50);
  w.move_by(-4, 0);
  EXPECT_EQ((Rect{-4, 0, -4, 0}), log[2].area);
  EXPECT_EQ(96, w.get_cursor().x);
  w.advance_ms(60);
  w.move_by(-1, 2);
  EXPECT_EQ((Rect{-1, 2, -1, 2}), log[3].area);
  EXPECT_EQ(100, w.get_cursor().x);
}

TEST(ToolkitWindow, ReleaseInRelativeModeRestoresTheCursorOnlyAfter250Ms) {
  std::vector<Delivery> log;
  OffscreenWindow w(Size{300, 300});
  RecordingHandler h(&log);
  w.mouse_move(50, 60);
  MouseCapture early(2, &h);
  ASSERT_EQ(0, w.process_message(early));
  w.advance_ms(249);
  MouseRelease r1(&h, Point{10, 20});
  EXPECT_EQ(0, w.process_message(r1));
  EXPECT_EQ(50, w.get_cursor().x);
  EXPECT_FALSE(w.has_capture());
  EXPECT_EQ(1, count_kind(log, "handler", "lost"));

  MouseCapture late(2, &h);
  ASSERT_EQ(0, w.process_message(late));
  w.advance_ms(250);
  MouseRelease r2(&h, Point{10, 20});
  EXPECT_EQ(0, w.process_message(r2));
  EXPECT_EQ(10, w.get_cursor().x);
  EXPECT_EQ(20, w.get_cursor().y);
  EXPECT_FALSE(w.is_cursor_hidden());
}

TEST(ToolkitWindow, ReleaseFromAnotherThreadIsRefused) {
  std::vector<Delivery> log;
  OffscreenWindow w(Size{100, 100});
  RecordingHandler h(&log);
  MouseCapture cap(0, &h);
  ASSERT_EQ(0, w.process_message(cap));
  int32_t answer = 0;
  std::thread other([&] {
    MouseRelease r(&h, Point{0, 0});
    answer = w.process_message(r);
  });
  other.join();
  EXPECT_EQ(-1, answer);
  EXPECT_TRUE(w.has_capture());
}

TEST(ToolkitWindow, TimersTickAtTheirPeriodWithTheClockTime) {
  OffscreenWindow w(Size{10, 10});
  TimerSink sink;
  int32_t id = -1;
  SetTimer set(0.03f, &sink, &id);
  uint32_t start = w.now_ms();
  ASSERT_EQ(0, w.process_message(set));
  w.advance_ms(100);
  ASSERT_EQ(3u, sink.times.size());
  for (size_t i = 0; i < 3; ++i) {
    EXPECT_DOUBLE_EQ((start + 30.0 * (i + 1)) * 0.001, sink.times[i]);
    EXPECT_EQ(id, sink.ids[i]);
  }
  EXPECT_DOUBLE_EQ((start + 100) * 0.001, toolkit_now()) << "the window's clock is the toolkit's";

  ClearTimer clear(id);
  EXPECT_EQ(0, w.process_message(clear));
  w.advance_ms(1000);
  EXPECT_EQ(3u, sink.times.size()) << "no Notify after ClearTimer";
  ClearTimer twice(id);
  EXPECT_EQ(-1, w.process_message(twice));
  EXPECT_EQ(0u, w.get_running_timer_count());
}

TEST(ToolkitWindow, ATimerClearedFromItsOwnTickNeverTicksAgain) {
  OffscreenWindow w(Size{10, 10});
  TimerSink sink;
  sink.window = &w;
  sink.clear_on_tick = 2;
  SetTimer set(0.01f, &sink);
  ASSERT_EQ(0, w.process_message(set));
  w.advance_ms(500);
  EXPECT_EQ(2u, sink.times.size());
}

TEST(ToolkitWindow, TimersOfTwoWindowsAreKeptApartAndDieWithTheirWindow) {
  TimerSink a_sink, b_sink;
  OffscreenWindow a(Size{10, 10});
  {
    OffscreenWindow b(Size{10, 10});
    SetTimer ta(0.02f, &a_sink);
    SetTimer tb(0.05f, &b_sink);
    ASSERT_EQ(0, a.process_message(ta));
    ASSERT_EQ(0, b.process_message(tb));
    b.advance_ms(100);
    EXPECT_EQ(0u, a_sink.times.size()) << "b's clock does not fire a's timers";
    EXPECT_EQ(2u, b_sink.times.size());
    ClearTimer wrong(tb.timer_id);
    EXPECT_EQ(-1, a.process_message(wrong)) << "a timer is cleared through its own window";
    b.close();
    EXPECT_EQ(0u, b.get_running_timer_count());
  }
  a.advance_ms(40);
  EXPECT_EQ(2u, a_sink.times.size());
}

TEST(ToolkitWindow, ARefusedTimerAnswersMinusOne) {
  OffscreenWindow w(Size{10, 10});
  TimerSink sink;
  w.refuse_timers(true);
  SetTimer set(0.03f, &sink);
  EXPECT_EQ(-1, w.process_message(set));
  w.advance_ms(100);
  EXPECT_TRUE(sink.times.empty());
}

TEST(ToolkitWindow, TextInputStartsStopsAndReportsToTheRequester) {
  std::vector<Delivery> log;
  OffscreenWindow w(Size{100, 100});
  RecordingHandler first(&log, "first");
  RecordingHandler second(&log, "second");
  TextInputStop nothing(true);
  EXPECT_EQ(-1, w.process_message(nothing));

  TextInputRequest a(Rect{1, 2, 30, 12}, "abc", &first);
  EXPECT_EQ(0, w.process_message(a));
  EXPECT_TRUE(w.line_editor().is_active());
  EXPECT_EQ("abc", w.line_editor().get_text());
  TextInputRequest b(Rect{1, 2, 30, 12}, "x", &second);
  EXPECT_EQ(0, w.process_message(b));
  ASSERT_EQ(1u, log.size());
  EXPECT_EQ("first", log[0].node);
  EXPECT_EQ("text drop abc", log[0].kind) << "a new request drops the running edit";

  w.line_editor().type(std::string(1500, 'q'));
  TextInputStop accept(true);
  EXPECT_EQ(0, w.process_message(accept));
  ASSERT_EQ(2u, log.size());
  EXPECT_EQ("second", log[1].node);
  EXPECT_EQ("text accept " + std::string(1023, 'q'), log[1].kind) << "cut to 1023 characters";
  EXPECT_FALSE(w.line_editor().is_active());
}
