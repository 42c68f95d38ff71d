// Band-split sliders: ordering, band counting and band hiding.
#include <gtest/gtest.h>

#include <array>

#include "editor/band_display_interface.h"
#include "editor/band_splt_listener.h"
#include "guikit/fader.h"
#include "params/listener_plugin_stage.h"

using guikit::Point;
using listener_test::PluginStage;

namespace {

struct ShownBands : BandDisplayInterface {
  std::array<bool, 4> shown{{true, true, true, true}};
  int band0_calls = 0;
  void show_band(int band, bool on) override {
    if (band == 0) ++band0_calls;
    shown[band] = on;
  }
};

struct SplitStage : PluginStage {
  std::array<guikit::Fader, 3> faders{{guikit::Fader(false), guikit::Fader(false), guikit::Fader(false)}};
  std::array<BandSpltListener, 3> splits{{BandSpltListener(0), BandSpltListener(1), BandSpltListener(2)}};
  ShownBands bands;
  SplitStage() {
    for (int k = 0; k < 3; ++k) {
      splits[k].set_host_gui(&adapter);
      splits[k].bind_param(9 + k, &param(9 + k));
      splits[k].set_splits({{&splits[0], &splits[1], &splits[2]}});
      splits[k].set_band_display(&bands);
      faders[k].set_travel_length(437);
      faders[k].set_listener(&splits[k]);
      stage.add(faders[k], Point{162, 10 + 10 * k}, guikit::Rect{-4, -3, 448, 4});
    }
  }
  // A change by the user, then the button going up gives the parameter back.
  void drag(int k, double v) {
    ASSERT_TRUE(faders[k].set_value_by_user(v, guikit::kOriginMouse));
    splits[k].end_change(guikit::kOriginMouse);
  }
  std::array<double, 3> values() const {
    return {{faders[0].get_value(), faders[1].get_value(), faders[2].get_value()}};
  }
};

}  // namespace

TEST(BandSplit, CountingStopsAtTheFirstSplitAtItsMaximum) {
  EXPECT_EQ(BandSpltListener::count_bands({{1.0, 1.0, 1.0}}), 1);
  EXPECT_EQ(BandSpltListener::count_bands({{0.2, 0.5, 0.8}}), 4);
  EXPECT_EQ(BandSpltListener::count_bands({{0.2, 1.0, 0.3}}), 2) << "only leading splits count";
  EXPECT_EQ(BandSpltListener::count_bands({{1.0 - 1e-10, 0.5, 0.5}}), 1) << "within 1e-9 of the maximum";
  EXPECT_EQ(BandSpltListener::count_bands({{1.0 - 1e-8, 1.0, 1.0}}), 2);
  EXPECT_EQ(BandSpltListener::count_bands({{0.0, 0.0, 1.0}}), 3);
}

TEST(BandSplit, DraggedSplitsPushTheOthersAlongAndWriteTheirParameters) {
  SplitStage s;
  ASSERT_NE(s.effect, nullptr);
  for (auto& l : s.splits) ASSERT_TRUE(l.refresh());
  EXPECT_EQ(s.values(), (std::array<double, 3>{{1.0, 1.0, 1.0}})) << "the defaults are at the maximum";
  EXPECT_EQ(s.bands.shown, (std::array<bool, 4>{{true, false, false, false}}));

  s.drag(0, 0.2);
  s.drag(1, 0.5);
  s.drag(2, 0.8);
  EXPECT_EQ(s.bands.shown, (std::array<bool, 4>{{true, true, true, true}}));

  // Split 1 below split 0 drags split 0 down; split 2, higher already, stays.
  s.drag(1, 0.1);
  EXPECT_EQ(s.values(), (std::array<double, 3>{{0.1, 0.1, 0.8}}));
  EXPECT_EQ(s.get(9), 0.1f);
  EXPECT_EQ(s.get(10), 0.1f);
  EXPECT_EQ(s.get(11), 0.8f);
  ASSERT_FALSE(s.automated(9).empty());
  EXPECT_EQ(s.automated(9).back(), 0.1f) << "the pushed split is reported like a drag";

  // Split 0 past both others pushes them up.
  s.drag(0, 0.9);
  EXPECT_EQ(s.values(), (std::array<double, 3>{{0.9, 0.9, 0.9}}));
  for (int k = 0; k < 3; ++k) EXPECT_EQ(s.get(9 + k), 0.9f);

  // Split 1 at its maximum: bands 3 and 4 (2 and 3) go.
  s.drag(1, 1.0);
  EXPECT_EQ(s.values(), (std::array<double, 3>{{0.9, 1.0, 1.0}}));
  EXPECT_EQ(s.bands.shown, (std::array<bool, 4>{{true, true, false, false}}));
  s.drag(0, 1.0);
  EXPECT_EQ(s.bands.shown, (std::array<bool, 4>{{true, false, false, false}}));
  s.drag(0, 0.4);
  EXPECT_EQ(s.bands.shown, (std::array<bool, 4>{{true, true, false, false}}));
  EXPECT_EQ(s.bands.band0_calls, 0) << "the first band is never hidden";
  for (auto& l : s.splits) EXPECT_TRUE(l.is_enabled());
}

TEST(BandSplit, ChangesFromOutsideRecountButDoNotReorder) {
  SplitStage s;
  ASSERT_NE(s.effect, nullptr);
  for (auto& l : s.splits) ASSERT_TRUE(l.refresh());
  s.drag(0, 0.3);
  s.drag(1, 0.6);
  EXPECT_EQ(s.bands.shown, (std::array<bool, 4>{{true, true, true, false}}));
  const size_t reported = s.host.automations.size();

  // The host moves split 1 below split 0; the editor follows it as a change from outside.
  s.host_set(10, 0.1f);
  ASSERT_TRUE(s.faders[1].set_value(s.get(10), 100));
  EXPECT_EQ(s.faders[0].get_value(), 0.3) << "no push from outside";
  EXPECT_EQ(s.host.automations.size(), reported);

  s.host_set(9, 1.0f);
  ASSERT_TRUE(s.faders[0].set_value(s.get(9), 100));
  EXPECT_EQ(s.bands.shown, (std::array<bool, 4>{{true, false, false, false}}));
}
