#include <gtest/gtest.h>

#include <cmath>

#include "controls_test_support.h"
#include "guikit/diode.h"
#include "guikit/push_button.h"
#include "guikit/text_box.h"
#include "guikit/unicolor_font.h"

using namespace guikit;
using guikit_test::RecordingListener;
using guikit_test::SolidPicture;
using guikit_test::Stage;

TEST(ControlsPushButton, FlashRisesToTheLastFrameAndFallsBackOnTheTimer) {
  Stage s;
  PushButton b;
  RecordingListener rec;
  b.set_listener(&rec);
  s.add(b, Point{10, 10}, Rect{0, 0, 20, 20});
  s.window.click_at(15, 15);
  EXPECT_EQ(std::vector<int32_t>{0}, rec.events) << "pressed: event (0, 0)";
  ASSERT_GE(b.get_timer_id(), 0);
  s.window.button_up();
  EXPECT_EQ(1, rec.releases);

  // Ticks every 30 ms of a 100 ms flash: 2e/d on the way up, 2(1 - e/d) down.
  const double expected[] = {0.6, 0.8, 0.2};
  for (double want : expected) {
    s.window.advance_ms(30);
    EXPECT_NEAR(want, b.get_flash_position(), 1e-9);
  }
  EXPECT_EQ(1, b.frame_for(0.6));
  EXPECT_EQ(0, b.frame_for(0.2));
  s.window.advance_ms(30);
  EXPECT_EQ(0.0, b.get_flash_position());
  EXPECT_EQ(-1, b.get_timer_id());
  EXPECT_EQ(0u, s.window.get_running_timer_count());
}

TEST(ControlsPushButton, AButtonWithoutATimerStillReportsThePress) {
  Stage s;
  PushButton b;
  RecordingListener rec;
  b.set_listener(&rec);
  s.add(b, Point{0, 0}, Rect{0, 0, 20, 20});
  s.window.refuse_timers(true);
  s.window.click_at(5, 5);
  EXPECT_EQ(1u, rec.events.size());
  EXPECT_EQ(-1, b.get_timer_id());
}

TEST(ControlsFlipFlop, TogglesAroundOneHalf) {
  Stage s;
  FlipFlop f;
  s.add(f, Point{0, 0}, Rect{0, 0, 20, 20});
  f.set_value(0.4, 0);
  s.window.click_at(5, 5);
  EXPECT_EQ(1.0, f.get_value());
  s.window.button_up();
  f.set_value(0.5, 0);
  s.window.button_down();
  EXPECT_EQ(0.0, f.get_value());
}

TEST(ControlsFlipFlop, MidTransitionShowsTheFadingFrame) {
  Stage s(Size{40, 40});
  SolidPicture off(10, 10, 0x00101010), on(10, 10, 0x00E0C0A0);
  FlipFlop f;
  RecordingListener rec;
  f.set_listener(&rec);
  f.set_frames({off.at(0, 0), on.at(0, 0)});
  f.set_transition_time(0.1);
  s.add(f, Point{5, 5}, Rect{0, 0, 10, 10});
  s.window.paint_all();
  EXPECT_EQ(0x00101010u, s.window.pixel(6, 6));

  s.window.click_at(8, 8);
  ASSERT_EQ(1u, rec.changes.size());
  EXPECT_EQ(200, rec.changes[0].origin);
  EXPECT_EQ(1.0, f.get_value()) << "the value switches at once";
  s.window.paint_all();
  EXPECT_EQ(0x00101010u, s.window.pixel(6, 6)) << "the display starts from the old state";
  s.window.advance_ms(30);  // position 0.3: still the first frame
  EXPECT_NEAR(0.3, f.get_display_position(), 1e-9);
  s.window.paint_all();
  EXPECT_EQ(0x00101010u, s.window.pixel(10, 10));
  s.window.advance_ms(30);  // position 0.6: the second frame
  s.window.paint_all();
  EXPECT_EQ(0x00E0C0A0u, s.window.pixel(10, 10));
  EXPECT_EQ(0u, s.window.pixel(15, 15)) << "outside the control nothing is drawn";
  s.window.advance_ms(60);
  EXPECT_EQ(-1, f.get_timer_id());
  EXPECT_EQ(1.0, f.get_display_position());
}

TEST(ControlsFlipFlop, AVetoedToggleKeepsValueAndDisplay) {
  Stage s;
  FlipFlop f;
  RecordingListener rec;
  rec.allow_left = 0;
  f.set_listener(&rec);
  f.set_transition_time(0.1);
  s.add(f, Point{0, 0}, Rect{0, 0, 20, 20});
  s.window.click_at(5, 5);
  EXPECT_EQ(0.0, f.get_value());
  EXPECT_EQ(-1, f.get_timer_id());
}

TEST(ControlsDiode, PollsItsListenersOnlyWhileVisible) {
  Stage s;
  Diode d;
  RecordingListener rec;
  d.set_listener(&rec);
  d.set_refresh_period(0.05f);
  s.add(d, Point{0, 0}, Rect{0, 0, 5, 5});
  ASSERT_GE(d.get_timer_id(), 0) << "shown by its group: the timer runs";
  s.window.advance_ms(160);
  EXPECT_EQ((std::vector<int32_t>{2, 2, 2}), rec.events);
  ShowObject hide(false);
  s.group.process_message(hide);
  EXPECT_EQ(-1, d.get_timer_id());
  s.window.advance_ms(500);
  EXPECT_EQ(3u, rec.events.size());

  d.set_value(0.6, 0);
  EXPECT_EQ(1.0, d.get_shown_level());
  d.set_override(true);
  d.set_display_level(0.25);
  d.set_frames({Picture(), Picture(), Picture(), Picture(), Picture()});
  EXPECT_EQ(1, d.frame_for(d.get_shown_level()));
}

TEST(ControlsTextBox, EditingThroughTheWindowAcceptsOrDrops) {
  Stage s;
  TextBox box;
  RecordingListener rec;
  box.set_listener(&rec);
  box.set_text("old");
  box.set_editable(true);
  s.add(box, Point{50, 60}, Rect{0, 0, 40, 12});

  s.window.click_at(55, 65);
  ASSERT_TRUE(box.is_editing());
  EXPECT_EQ("old", s.window.line_editor().get_text());
  EXPECT_EQ((Rect{50, 60, 90, 72}), s.window.line_editor().get_rect());
  s.window.button_up();
  s.window.line_editor().type("new");
  TextInputStop escape(false);
  s.window.process_message(escape);
  EXPECT_FALSE(box.is_editing());
  EXPECT_EQ("old", box.get_text()) << "Escape keeps the text";
  EXPECT_TRUE(rec.events.empty());

  s.window.button_down();
  s.window.line_editor().type("new");
  TextInputStop ret(true);
  s.window.process_message(ret);
  EXPECT_EQ("new", box.get_text());
  EXPECT_EQ(std::vector<int32_t>{2}, rec.events);

  // Hiding the box while editing drops the edit.
  s.window.button_up();
  s.window.button_down();
  s.window.line_editor().type("lost");
  ShowObject hide(false);
  box.process_message(hide);
  EXPECT_FALSE(s.window.line_editor().is_active());
  EXPECT_EQ("new", box.get_text());
}

TEST(ControlsTextBox, AFixedBoxReportsClicks) {
  Stage s;
  TextBox box;
  RecordingListener rec;
  box.set_listener(&rec);
  s.add(box, Point{0, 0}, Rect{0, 0, 40, 12});
  s.window.click_at(1, 1);
  EXPECT_EQ(std::vector<int32_t>{1}, rec.events);
  EXPECT_FALSE(s.window.line_editor().is_active());
}

TEST(ControlsNeedle, TurnsAboutItsPivotAndPollsOnItsTimer) {
  Stage s(Size{80, 80});
  SolidPicture bar(20, 3, 0x00FFFFFF, 255, true);
  SolidPicture dial(80, 80, 0x00000000);
  VuMeterNeedle n;
  n.set_background(dial.at(0, 0));
  RecordingListener rec;
  n.set_listener(&rec);
  n.set_needle(bar.at(0, 0));
  n.set_refresh_period(0.04f);
  n.set_geometry(0.25, 0.0, Point{30, 40}, 0.0);
  s.add(n, Point{0, 0}, Rect{0, 0, 80, 80});
  s.window.advance_ms(90);
  EXPECT_EQ((std::vector<int32_t>{0, 0}), rec.events);

  s.window.paint_all();  // value 0: the bar lies to the right of the pivot
  EXPECT_GT(guikit_test::red_of(s.window.pixel(40, 41)), 200u);
  EXPECT_LT(guikit_test::red_of(s.window.pixel(31, 30)), 30u);

  n.set_value(1.0, 0);  // a quarter turn: the bar points up
  EXPECT_NEAR(std::acos(-1.0) / 2, n.get_angle(), 1e-12);
  s.window.paint_all();
  EXPECT_GT(guikit_test::red_of(s.window.pixel(31, 30)), 200u);
  EXPECT_LT(guikit_test::red_of(s.window.pixel(40, 41)), 30u);
  EXPECT_LT(guikit_test::red_of(s.window.pixel(31, 50)), 30u);
}

namespace {

// Glyphs 0..64 one column wide and empty; glyph 65 ('A') three columns, fully covered.
struct TinyFont {
  static constexpr int32_t kWidth = 68;
  static constexpr int32_t kRows = 4;
  std::vector<uint8_t> bytes;
  std::unique_ptr<guikit::UnicolorFont> font;
  TinyFont() : bytes(static_cast<size_t>(kWidth * (kRows + 1)), 0) {
    for (int32_t y = 0; y < kRows; ++y)
      for (int32_t x = 65; x < 68; ++x) bytes[static_cast<size_t>(y * kWidth + x)] = 255;
    uint8_t* marker = &bytes[static_cast<size_t>(kRows * kWidth)];
    for (int32_t x = 0; x < 65; ++x) marker[x] = (x % 2) ? 255 : 0;
    for (int32_t x = 65; x < 68; ++x) marker[x] = 255;
    font = std::make_unique<guikit::UnicolorFont>(guikit::Size{kWidth, kRows + 1}, bytes.data());
  }
};

}  // namespace

TEST(ControlsTextBox, DrawsItsTextInsideTheMarginsWithItsAlignment) {
  Stage s(Size{40, 30});
  TinyFont tiny;
  ASSERT_EQ(66, tiny.font->get_glyph_count());
  SolidPicture paper(20, 8, 0x00000000);
  TextBox box;
  box.set_background(paper.at(0, 0));
  box.set_font(tiny.font.get());
  box.set_text("A");
  box.set_colour(0x00FF0000);
  box.set_margins(Rect{2, 1, 0, 0});
  s.add(box, Point{10, 10}, Rect{0, 0, 20, 8});
  s.window.paint_all();
  EXPECT_GT(guikit_test::red_of(s.window.pixel(12, 11)), 250u);
  EXPECT_GT(guikit_test::red_of(s.window.pixel(14, 14)), 250u);
  EXPECT_EQ(0u, s.window.pixel(12, 10)) << "the top margin";
  EXPECT_EQ(0u, s.window.pixel(11, 12)) << "the left margin";
  EXPECT_EQ(0u, s.window.pixel(15, 12));
  EXPECT_EQ(0u, s.window.pixel(12, 15)) << "glyphs are four rows high";

  box.set_alignment(kAlignCentre);
  box.request_redraw();
  s.window.paint_pending();
  EXPECT_EQ(0u, s.window.pixel(12, 12));
  EXPECT_GT(guikit_test::red_of(s.window.pixel(20, 12)), 250u) << "centred in the 18 pixels inside the margins";
}
