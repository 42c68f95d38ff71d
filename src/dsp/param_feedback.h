#pragma once

#include "params/normalized_param_interface.h"

// Amount of the output fed back through the tuned line, 0..1 as a percentage.
class ParamFeedbackAmount : public plugcore::NormalizedParamInterface {
 public:
  void get_name(char* text, int capacity) const override;
  void get_unit(char* text, int capacity) const override;
  double conv_norm_to_value(float norm) const override;
  float conv_value_to_norm(double value) const override;
  void conv_value_to_text(char* text, int capacity, double value) const override;
  double conv_text_to_value(const char* text, bool& ok) const override;
};

// Tuning of the feedback line, 16..1024 Hz on a logarithmic scale.
class ParamFeedbackPitch : public plugcore::NormalizedParamInterface {
 public:
  void get_name(char* text, int capacity) const override;
  void get_unit(char* text, int capacity) const override;
  double conv_norm_to_value(float norm) const override;
  float conv_value_to_norm(double value) const override;
  void conv_value_to_text(char* text, int capacity, double value) const override;
  double conv_text_to_value(const char* text, bool& ok) const override;
};
