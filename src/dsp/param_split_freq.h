#pragma once

#include "params/param_numbered.h"

// Upper edge of band k (split point k), 20..20480 Hz on a logarithmic scale.
class ParamBandSplitFrq : public plugcore::ParamNumbered {
 public:
  void get_name_prefix(char* text, int capacity) const override;
  void get_name_suffix(char* text, int capacity) const override;
  void get_unit(char* text, int capacity) const override;
  double conv_norm_to_value(float norm) const override;
  float conv_value_to_norm(double value) const override;
  void conv_value_to_text(char* text, int capacity, double value) const override;
  double conv_text_to_value(const char* text, bool& ok) const override;
};
