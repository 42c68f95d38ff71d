// The companions wired by the editor: band links behind the band controls,
// lamps behind their knobs and switch, the clip lamp behind the engine.
#include <cmath>
#include <vector>

#include "gui_test_support.h"

using gui_test::EditorInstance;

namespace {

constexpr int kDistAmnt = 14;  // band 1; + 7 per band

class LinkedEditor : public EditorInstance {
 protected:
  void SetUp() override {
    EditorInstance::SetUp();
    ASSERT_TRUE(open_editor());
    for (int k = 0; k < 3; ++k) effect->setParameter(effect, 9 + k, 0.25f * (k + 1));  // every band in use
    for (int c = 0; c < 4; ++c) effect->setParameter(effect, kDistAmnt + 7 * c, 0.1f * (c + 1));
    window->advance_ms(600);  // the host's hold on the parameters ends
  }
  // Right-button drag of band 2's Dist Amnt knob (at (291, 197)) upward.
  void drag_band2(uint32_t modifiers) {
    window->mouse_move(291, 197);
    window->button_down(guikit::kButtonRight, modifiers);
    for (int step = 0; step < 6; ++step) {
      window->move_by(0, -10);
      window->advance_ms(30);
    }
    window->advance_ms(300);  // held still: the knob reaches the mouse before the release
    window->button_up(guikit::kButtonRight, modifiers);
    window->advance_ms(400);
  }
};

}  // namespace

TEST_F(LinkedEditor, RightButtonDragMovesTheSameControlOfEveryBand) {
  drag_band2(0);
  const float v = norm(kDistAmnt + 7);
  EXPECT_GT(v, 0.2f + 0.05f) << "band 2 moved up";
  for (int c = 0; c < 4; ++c) {
    EXPECT_FLOAT_EQ(norm(kDistAmnt + 7 * c), v) << "band " << c + 1;
    EXPECT_FLOAT_EQ(static_cast<float>(control_value(kDistAmnt + 7 * c)), v) << "band " << c + 1;
  }
  EXPECT_GT(automations_of(kDistAmnt), 0) << "the linked bands are written like the dragged one";
}

TEST_F(LinkedEditor, TheGlideAfterAQuickReleaseReachesTheLinkedBandsToo) {
  window->mouse_move(291, 197);
  window->button_down(guikit::kButtonRight);
  for (int step = 0; step < 4; ++step) {
    window->move_by(0, -12);
    window->advance_ms(10);  // faster than the glide: the knob lags behind the mouse
  }
  window->button_up(guikit::kButtonRight);
  const float at_release = norm(kDistAmnt + 7);
  window->advance_ms(600);
  const float v = norm(kDistAmnt + 7);
  ASSERT_GT(v, at_release + 0.01f) << "the knob glides on after the release";
  for (int c : {0, 2, 3}) EXPECT_FLOAT_EQ(norm(kDistAmnt + 7 * c), v) << "band " << c + 1;
}

TEST_F(LinkedEditor, ControlMirrorsTheLinkedBands) {
  drag_band2(guikit::kModControl);
  const float v = norm(kDistAmnt + 7);
  for (int c : {0, 2, 3}) EXPECT_NEAR(norm(kDistAmnt + 7 * c), 1.0f - v, 1e-6f) << "band " << c + 1;
}

TEST_F(LinkedEditor, LeftButtonDragMovesOnlyItsOwnBand) {
  window->mouse_move(291, 197);
  window->button_down();
  window->move_by(0, -30);
  window->advance_ms(30);
  window->button_up();
  window->advance_ms(400);
  EXPECT_GT(norm(kDistAmnt + 7), 0.25f);
  EXPECT_FLOAT_EQ(norm(kDistAmnt), 0.1f);
  EXPECT_FLOAT_EQ(norm(kDistAmnt + 14), 0.3f);
  EXPECT_FLOAT_EQ(norm(kDistAmnt + 21), 0.4f);
}

TEST_F(LinkedEditor, LampsFollowTheirCompanions) {
  // Lamps at (68, 44) for Tone Shape, (120, 169) for Stereo Boost, (92, 107) for Fdbk Amnt.
  const int companion[3] = {3, 0, 5};
  for (int k = 0; k < 3; ++k) {
    effect->setParameter(effect, companion[k], 0.0f);
    EXPECT_EQ(gui->use_master().lamp(k).get_value(), 0.0) << k;
    effect->setParameter(effect, companion[k], 1.0f);
    EXPECT_EQ(gui->use_master().lamp(k).get_value(), 1.0) << k;
  }
}

TEST_F(LinkedEditor, ClipLampLightsOnAClippingBlock) {
  effect->setParameter(effect, 7, 1.0f);  // Master Vol up
  std::vector<float> left(256), right(256), out_l(256), out_r(256);
  float* in[2] = {left.data(), right.data()};
  float* out[2] = {out_l.data(), out_r.data()};
  for (size_t i = 0; i < left.size(); ++i) left[i] = right[i] = 8.0f * static_cast<float>(std::sin(0.05 * i));
  effect->processReplacing(effect, in, out, 256);
  float peak = 0.0f;
  for (float s : out_l) peak = std::fabs(s) > peak ? std::fabs(s) : peak;
  ASSERT_GT(peak, 1.0f) << "the block clips";
  window->advance_ms(60);
  EXPECT_EQ(gui->use_master().clip_diode().get_value(), 1.0);
}
