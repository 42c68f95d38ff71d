#include <gtest/gtest.h>

#include <cmath>

#include "controls_test_support.h"
#include "guikit/fader.h"
#include "guikit/knob.h"

using namespace guikit;
using guikit_test::RecordingListener;
using guikit_test::SolidPicture;
using guikit_test::Stage;

namespace {

const double kPi = std::acos(-1.0);

// A 40 x 40 knob at (100, 100) in relative mouse mode.
struct KnobStage : Stage {
  Knob knob;
  RecordingListener rec;
  KnobStage() {
    PotBehaviour::set_mouse_compatibility(0);
    knob.set_listener(&rec);
    add(knob, Point{100, 100}, Rect{0, 0, 40, 40});
  }
  // A press in the drag area (upper middle), then moves at the same instant.
  void press_middle() { window.click_at(120, 110); }
  void settle() { window.advance_ms(3000); }
};

std::vector<double> dist_type_magnets() {
  std::vector<double> m;
  float v = 0.0f;
  for (int i = 0; i < 13; ++i) {
    m.push_back(std::min(1.0, std::max(0.0, static_cast<double>(v))));
    v += 1.0f / 12.0f;
  }
  return m;
}

}  // namespace

TEST(PotsDrag, TwoHundredPixelsUpFromZeroSettleAtOne) {
  KnobStage s;
  s.press_middle();
  EXPECT_TRUE(s.window.has_capture());
  EXPECT_TRUE(s.window.is_cursor_hidden()) << "relative mode hides the cursor";
  for (int i = 0; i < 4; ++i) s.window.move_by(0, -50);
  EXPECT_DOUBLE_EQ(1.0, s.knob.behaviour().get_target());
  EXPECT_EQ(0.0, s.knob.get_value()) << "no time passed: the glide has not moved yet";
  s.settle();
  EXPECT_EQ(1.0, s.knob.get_value());
  ASSERT_FALSE(s.rec.changes.empty());
  for (const auto& c : s.rec.changes) EXPECT_EQ(200, c.origin) << "button held: mouse origin";
  EXPECT_GT(s.rec.holds, 0);
}

TEST(PotsDrag, OvershootIsForgottenAsSoonAsTheMovementTurnsBack) {
  KnobStage s;
  s.press_middle();
  s.window.move_by(0, -200);
  s.window.move_by(0, -100);
  EXPECT_DOUBLE_EQ(1.5, s.knob.behaviour().get_position());
  s.settle();
  EXPECT_EQ(1.0, s.knob.get_value());
  s.window.move_by(0, 10);
  s.settle();
  EXPECT_NEAR(1.0 - 10.0 / 200.0, s.knob.get_value(), 1e-12);
  // The same at the lower end.
  s.window.move_by(0, 400);
  s.window.move_by(0, -20);
  s.settle();
  EXPECT_NEAR(20.0 / 200.0, s.knob.get_value(), 1e-12);
}

TEST(PotsDrag, SidewaysMotionCountsOnlyWithASecondaryFactor) {
  KnobStage s;
  s.knob.set_value(0.3, 0);
  s.rec.changes.clear();
  s.press_middle();
  for (int i = 0; i < 8; ++i) s.window.move_by(5, 0);
  s.settle();
  EXPECT_EQ(0.3, s.knob.get_value()) << "factor 0: nothing changes";
  EXPECT_TRUE(s.rec.changes.empty());
  EXPECT_EQ(1, s.knob.behaviour().get_axis_mode());
  s.window.button_up();
  s.settle();

  s.knob.set_secondary_factor(0.5f);
  s.window.button_down();
  for (int i = 0; i < 8; ++i) s.window.move_by(5, 0);
  s.settle();
  EXPECT_NEAR(0.3 + 40 * 0.5 / 200.0, s.knob.get_value(), 1e-9);
  // Turning to a vertical movement goes back to the primary axis.
  s.window.move_by(0, -10);
  EXPECT_EQ(0, s.knob.behaviour().get_axis_mode());
}

TEST(PotsDrag, DistTypeMagnetsSnapAndHold) {
  KnobStage s;
  std::vector<double> magnets = dist_type_magnets();
  s.knob.set_magnets(&magnets);
  s.press_middle();
  s.window.move_by(0, -10);  // 0.05: not yet three times closer to 1/12 than to 0
  s.settle();
  EXPECT_EQ(0.0, s.knob.get_value());
  s.window.move_by(0, -4);  // 0.07: snaps
  s.settle();
  EXPECT_EQ(magnets[1], s.knob.get_value());
  s.window.move_by(0, 2);  // 0.06: the detent holds
  s.settle();
  EXPECT_EQ(magnets[1], s.knob.get_value());
  s.window.move_by(0, -12);  // 0.12: still nearest to 1/12
  s.settle();
  EXPECT_EQ(magnets[1], s.knob.get_value());
  s.window.move_by(0, -6);  // 0.15: next detent
  s.settle();
  EXPECT_EQ(magnets[2], s.knob.get_value());
}

TEST(PotsGlide, OneTickFromHalfAwayMovesByTheFirstOrderLaw) {
  KnobStage s;
  s.press_middle();
  s.window.move_by(0, -100);
  s.window.advance_ms(30);
  double expected = 0.5 * (1.0 - std::exp(-2.0 * kPi * 3.0 * 0.03));
  EXPECT_NEAR(expected, s.knob.get_value(), 1e-12);
  EXPECT_NEAR(0.216, s.knob.get_value(), 1e-3);
  // The next tick closes in faster: k grows with the ratio of the distances.
  double d1 = 0.5 - expected;
  double k = 3.0 * 0.5 / d1;
  s.window.advance_ms(30);
  EXPECT_NEAR(expected + d1 * (1.0 - std::exp(-2.0 * kPi * k * 0.03)), s.knob.get_value(), 1e-12);
}

TEST(PotsRelease, TheGlideFinishesWithGlideOriginAndThePotStops) {
  KnobStage s;
  s.press_middle();
  s.window.move_by(0, -100);
  s.window.advance_ms(30);
  s.rec.changes.clear();
  s.window.button_up();
  EXPECT_EQ(std::vector<int32_t>{200}, s.rec.ends);
  EXPECT_EQ(1, s.rec.releases);
  EXPECT_FALSE(s.window.has_capture());
  EXPECT_FALSE(s.window.is_cursor_hidden());
  EXPECT_EQ(1u, s.window.get_running_timer_count()) << "the glide goes on after release";
  s.settle();
  EXPECT_DOUBLE_EQ(0.5, s.knob.get_value());
  ASSERT_FALSE(s.rec.changes.empty());
  for (const auto& c : s.rec.changes) EXPECT_EQ(50, c.origin);
  EXPECT_EQ(0u, s.window.get_running_timer_count());
  EXPECT_EQ(PotBehaviour::kIdle, s.knob.behaviour().get_state());
}

TEST(PotsRelease, RelativeModePutsTheCursorBackAtTheReleasePointAfter250Ms) {
  KnobStage s;
  s.press_middle();
  s.window.move_by(0, -50);
  EXPECT_EQ(60, s.window.get_cursor().y);
  s.window.advance_ms(300);
  s.window.button_up();
  EXPECT_EQ(120, s.window.get_cursor().x);
  EXPECT_EQ(110, s.window.get_cursor().y);
  s.settle();

  // Released too soon, the cursor stays where it is.
  s.window.mouse_move(125, 115);
  s.window.button_down();
  s.window.move_by(0, -30);
  s.window.advance_ms(100);
  s.window.button_up();
  EXPECT_EQ(85, s.window.get_cursor().y);
}

TEST(PotsRelease, CompatibleModeCapturesPlainlyAndReadsAbsolutePositions) {
  KnobStage s;
  PotBehaviour::set_mouse_compatibility(1);
  s.press_middle();
  EXPECT_FALSE(s.window.is_cursor_hidden());
  EXPECT_FALSE(s.knob.behaviour().is_relative());
  // The first move only sets the reference; movement counts from there.
  s.window.mouse_move(120, 90);
  s.window.mouse_move(120, 70);
  s.window.mouse_move(120, 60);
  s.settle();
  EXPECT_NEAR(30.0 / 200.0, s.knob.get_value(), 1e-12);
  PotBehaviour::set_mouse_compatibility(0);
}

TEST(PotsVeto, ARefusedChangeEndsTheGesture) {
  KnobStage s;
  s.rec.allow_left = 1;  // the tick's hold question passes, the first change does not
  s.press_middle();
  s.window.move_by(0, -100);
  s.window.advance_ms(30);
  EXPECT_EQ(0.0, s.knob.get_value());
  EXPECT_EQ(PotBehaviour::kIdle, s.knob.behaviour().get_state());
  EXPECT_FALSE(s.window.has_capture());
  EXPECT_EQ(0u, s.window.get_running_timer_count());
  EXPECT_FALSE(s.knob.is_active());
  s.window.move_by(0, -100);
  s.window.advance_ms(300);
  EXPECT_EQ(0.0, s.knob.get_value());
}

TEST(PotsVeto, ARefusedCaptureOrTimerLeavesThePotIdle) {
  KnobStage s;
  s.window.refuse_timers(true);
  s.press_middle();
  EXPECT_EQ(PotBehaviour::kIdle, s.knob.behaviour().get_state());
  EXPECT_FALSE(s.window.has_capture()) << "the capture taken first is given back";
  s.window.button_up();
  s.window.refuse_timers(false);
  s.window.refuse_capture(true);
  s.window.button_down();
  EXPECT_EQ(PotBehaviour::kIdle, s.knob.behaviour().get_state());
  EXPECT_EQ(0u, s.window.get_running_timer_count());
}

TEST(PotsSpin, LowerCornersSpinTowardsTheirEnds) {
  KnobStage s;
  s.knob.set_value(0.5, 0);
  s.window.click_at(102, 138);  // lower left: towards 0
  EXPECT_EQ(PotBehaviour::kSpinning, s.knob.behaviour().get_state());
  EXPECT_EQ(-1.0, s.knob.behaviour().get_requested_velocity());
  EXPECT_FALSE(s.window.is_cursor_hidden()) << "spins capture in mode 0";
  s.window.advance_ms(30);
  // Slow spin-up: u = 8 r / 64 dt, then the value moves by u dt.
  double u = 8.0 * -1.0 / 64.0 * 0.03;
  EXPECT_NEAR(0.5 + u * 0.03, s.knob.get_value(), 1e-12);
  s.window.advance_ms(600);
  EXPECT_LT(s.knob.get_value(), 0.5 + u * 0.03);
  s.window.button_up();
  s.settle();
  EXPECT_EQ(PotBehaviour::kIdle, s.knob.behaviour().get_state()) << "the spin decays and stops after release";
  double low = s.knob.get_value();

  s.window.click_at(138, 138);  // lower right: towards 1
  EXPECT_EQ(1.0, s.knob.behaviour().get_requested_velocity());
  s.window.advance_ms(600);
  EXPECT_GT(s.knob.get_value(), low);
  s.window.button_up();
  s.settle();

  s.window.click_at(120, 139);  // bottom middle: a drag
  EXPECT_EQ(PotBehaviour::kDragging, s.knob.behaviour().get_state());
}

TEST(PotsSpin, SidewaysDistanceSetsTheSpeedAtOnce) {
  KnobStage s;
  s.knob.set_value(0.5, 0);
  s.window.click_at(138, 138);
  s.window.mouse_move(142, 138);  // 4 pixels: no change
  EXPECT_EQ(1.0, s.knob.behaviour().get_requested_velocity());
  s.window.mouse_move(118, 138);  // 20 pixels left
  EXPECT_DOUBLE_EQ(-400.0 / 65536.0, s.knob.behaviour().get_requested_velocity());
  s.window.advance_ms(30);
  EXPECT_DOUBLE_EQ(-400.0 / 65536.0, s.knob.behaviour().get_actual_velocity());
  EXPECT_NEAR(0.5 - 400.0 / 65536.0 * 0.03, s.knob.get_value(), 1e-12);
}

TEST(PotsFader, TheCapFollowsTheMouseOneToOneAndTheCursorReturnsToIt) {
  Stage s;
  PotBehaviour::set_mouse_compatibility(0);
  SolidPicture cap(8, 4, 0x0000FF00);
  Fader f(true);
  f.set_travel_length(100);
  f.set_cap(cap.at(0, 0));
  s.add(f, Point{10, 10}, Rect{0, 0, 8, 104});
  f.set_value(0.5, 0);
  s.window.click_at(12, 61);  // on the cap (60..64)
  ASSERT_EQ(PotBehaviour::kDragging, f.behaviour().get_state());
  s.window.move_by(0, -25);
  s.window.advance_ms(3000);
  EXPECT_NEAR(0.75, f.get_value(), 1e-12);
  EXPECT_EQ(25, f.behaviour().get_release_offset().y);
  s.window.button_up();
  EXPECT_EQ(10, s.window.get_cursor().x);
  EXPECT_EQ(35, s.window.get_cursor().y);
}

TEST(PotsFader, HorizontalFadersIncreaseToTheRightAndTrackClicksSpin) {
  Stage s;
  PotBehaviour::set_mouse_compatibility(0);
  SolidPicture cap(4, 8, 0x0000FF00);
  Fader f(false);
  f.set_travel_length(100);
  f.set_cap(cap.at(0, 0));
  s.add(f, Point{0, 0}, Rect{0, 0, 104, 8});
  s.window.click_at(1, 2);
  s.window.move_by(50, 0);
  s.window.advance_ms(3000);
  EXPECT_NEAR(0.5, f.get_value(), 1e-12);
  s.window.button_up();
  s.window.advance_ms(1000);
  s.window.click_at(90, 2);  // right of the cap: spin up
  EXPECT_EQ(PotBehaviour::kSpinning, f.behaviour().get_state());
  EXPECT_EQ(1.0, f.behaviour().get_requested_velocity());
  s.window.mouse_move(94, 2);  // under 5 pixels: no change
  EXPECT_EQ(1.0, f.behaviour().get_requested_velocity());
  s.window.mouse_move(100, 2);
  EXPECT_DOUBLE_EQ(100.0 / 65536.0, f.behaviour().get_requested_velocity());
}

TEST(PotsDrawing, KnobShowsTheFrameOfItsValue) {
  Stage s(Size{80, 80});
  const uint32_t colours[5] = {0x00100000, 0x00200000, 0x00300000, 0x00400000, 0x00500000};
  std::vector<std::unique_ptr<SolidPicture>> pics;
  std::vector<Picture> frames;
  for (uint32_t c : colours) {
    pics.push_back(std::make_unique<SolidPicture>(20, 20, c));
    frames.push_back(pics.back()->at(0, 0));
  }
  Knob k;
  // Frames spread over the 270-degree sweep: frame 0 at value 0, the last at 1.
  k.set_frames(frames, 0.625, -0.75 * 5.0 / 4.0);
  s.add(k, Point{30, 30}, Rect{0, 0, 20, 20});
  for (double v : {0.0, 0.1, 0.13, 0.5, 0.62, 0.9, 1.0}) {
    k.set_value(v, 0);
    s.window.paint_all();
    auto expected = static_cast<size_t>(std::floor(v * 4.0 + 0.5));
    EXPECT_EQ(colours[expected], s.window.pixel(35, 35)) << "value " << v;
    EXPECT_EQ(colours[expected], s.window.pixel(49, 49)) << "value " << v;
    EXPECT_EQ(0u, s.window.pixel(50, 50));
  }
}

TEST(PotsDrawing, KnobPointerRidesOnItsCircle) {
  Stage s(Size{80, 80});
  SolidPicture face(40, 40, 0x00000000);
  SolidPicture dot(1, 1, 0x00FF0000, 255, true);
  Knob k;
  k.set_background(face.at(0, 0));
  k.set_pointers(dot.at(0, 0), Picture(), Point{}, Point{20, 20}, 10.0, false);
  s.add(k, Point{10, 10}, Rect{0, 0, 40, 40});
  k.set_value(0.5, 0);  // straight up: 90 degrees
  s.window.paint_all();
  EXPECT_GT(guikit_test::red_of(s.window.pixel(30, 20)), 200u);
  EXPECT_LT(guikit_test::red_of(s.window.pixel(30, 40)), 10u);
  k.set_value(1.0 / 3.0, 0);  // 0.625 - 0.25 = 0.375 turns: 135 degrees, up and left
  s.window.paint_all();
  double a = 2 * kPi * 0.375;
  int32_t x = static_cast<int32_t>(std::floor(30 + 10 * std::cos(a)));
  int32_t y = static_cast<int32_t>(std::floor(30 - 10 * std::sin(a)));
  uint32_t around = 0;
  for (int dy = 0; dy <= 1; ++dy)
    for (int dx = 0; dx <= 1; ++dx) around += guikit_test::red_of(s.window.pixel(x + dx, y + dy));
  EXPECT_GT(around, 200u) << "the dot's light lands on the four pixels around " << x << "," << y;
  EXPECT_LT(guikit_test::red_of(s.window.pixel(30, 20)), 10u);
}

TEST(PotsDrawing, FaderCapSitsAtItsValueFromTheBottom) {
  Stage s(Size{40, 140});
  SolidPicture track(8, 110, 0x000000FF);
  SolidPicture cap(8, 4, 0x0000FF00);
  Fader f(true);
  f.set_travel_length(100);
  f.set_background(track.at(0, 0));
  f.set_cap(cap.at(0, 0));
  s.add(f, Point{10, 10}, Rect{0, 0, 8, 110});
  f.set_value(0.25, 0);
  s.window.paint_all();
  EXPECT_EQ(0x0000FF00u, s.window.pixel(12, 85));
  EXPECT_EQ(0x0000FF00u, s.window.pixel(17, 88));
  EXPECT_EQ(0x000000FFu, s.window.pixel(12, 84));
  EXPECT_EQ(0x000000FFu, s.window.pixel(12, 89));
  f.set_value(1.0, 0);
  s.window.paint_all();
  EXPECT_EQ(0x0000FF00u, s.window.pixel(12, 10));
  EXPECT_EQ(0x000000FFu, s.window.pixel(12, 85));
}

TEST(PotsVeto, HidingAPotMidDragEndsEverything) {
  KnobStage s;
  s.press_middle();
  s.window.move_by(0, -40);
  ShowObject hide(false);
  s.group.process_message(hide);
  EXPECT_EQ(PotBehaviour::kIdle, s.knob.behaviour().get_state());
  EXPECT_FALSE(s.window.has_capture());
  EXPECT_FALSE(s.window.is_cursor_hidden());
  EXPECT_EQ(0u, s.window.get_running_timer_count());
  EXPECT_EQ(1, s.rec.releases);
}

TEST(PotsRelease, ALostCaptureEndsThePressAndTheGlideFinishes) {
  KnobStage s;
  s.press_middle();
  s.window.move_by(0, -40);
  s.window.advance_ms(300);
  s.window.lose_capture();
  EXPECT_FALSE(s.knob.behaviour().is_captured());
  EXPECT_EQ(std::vector<int32_t>{200}, s.rec.ends);
  EXPECT_TRUE(s.knob.is_released());
  EXPECT_EQ(70, s.window.get_cursor().y) << "no release was sent: the cursor stays";
  s.settle();
  EXPECT_NEAR(0.2, s.knob.get_value(), 1e-12);
  EXPECT_EQ(0u, s.window.get_running_timer_count());
  // The knob takes new clicks again.
  s.press_middle();
  EXPECT_EQ(PotBehaviour::kDragging, s.knob.behaviour().get_state());
}
