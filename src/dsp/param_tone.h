#pragma once

#include "params/normalized_param_interface.h"

// Tone filter corner, 2000..8000 Hz on a logarithmic scale.
class ParamToneFrq : public plugcore::NormalizedParamInterface {
 public:
  void get_name(char* text, int capacity) const override;
  void get_unit(char* text, int capacity) const override;
  double conv_norm_to_value(float norm) const override;
  float conv_value_to_norm(double value) const override;
  void conv_value_to_text(char* text, int capacity, double value) const override;
  double conv_text_to_value(const char* text, bool& ok) const override;
};

// Tone filter shape, 0..1 shown as a percentage.
class ParamToneColor : public plugcore::NormalizedParamInterface {
 public:
  void get_name(char* text, int capacity) const override;
  void get_unit(char* text, int capacity) const override;
  double conv_norm_to_value(float norm) const override;
  float conv_value_to_norm(double value) const override;
  void conv_value_to_text(char* text, int capacity, double value) const override;
  double conv_text_to_value(const char* text, bool& ok) const override;
};
