#pragma once

#include <array>
#include <cstdint>

#include "params/num_param_listener.h"

class BandDisplayInterface;

// The parameter listener of band-split slider k (0, 1, 2). A change by the user
// keeps the three splits in order (split 0 <= split 1 <= split 2) by pushing
// the others along; every change that reaches the slider also recounts the
// bands in use and shows or hides bands 1 to 3 through the band display.
//
// The three listeners know one another (set_splits, the same array for all
// three); each one's enabled flag stops it from pushing back while a sibling
// moves it.
class BandSpltListener : public plugcore::NumParamListener {
 public:
  explicit BandSpltListener(int split) : split_(split) {}
  int get_split() const { return split_; }
  void set_splits(const std::array<BandSpltListener*, 3>& splits) { splits_ = splits; }
  void set_band_display(BandDisplayInterface* display) { display_ = display; }
  void set_enabled(bool enabled) { enabled_ = enabled; }
  bool is_enabled() const { return enabled_; }

  double filter_user_value(double value, int32_t origin) override;
  double value_changed(double value, int32_t origin) override;

  // 1 + the number of leading splits below their maximum 1.0; a split within
  // 1e-9 of 1.0 ends the count.
  static int count_bands(const std::array<double, 3>& splits);

 private:
  double split_value(int j) const;

  int split_;
  std::array<BandSpltListener*, 3> splits_{{nullptr, nullptr, nullptr}};
  BandDisplayInterface* display_ = nullptr;
  bool enabled_ = true;
};
