#include "dsp/param_feedback.h"

#include <cmath>

#include "dsp/param_text.h"
#include "params/text_copy.h"

using plugcore::copy_text;

void ParamFeedbackAmount::get_name(char* text, int capacity) const { copy_text(text, "Fdbk Amnt", capacity); }
void ParamFeedbackAmount::get_unit(char* text, int capacity) const { copy_text(text, "%", capacity); }
double ParamFeedbackAmount::conv_norm_to_value(float norm) const { return norm; }
float ParamFeedbackAmount::conv_value_to_norm(double value) const { return static_cast<float>(value); }
void ParamFeedbackAmount::conv_value_to_text(char* text, int capacity, double value) const {
  write_percent_text(text, capacity, value);
}
double ParamFeedbackAmount::conv_text_to_value(const char* text, bool& ok) const {
  double percent = 0.0;
  if (!read_param_double(text, "%lf", percent)) {
    return 0.0;
  }
  ok = true;
  return clamp_param(percent * 0.01, 0.0, 1.0);
}

void ParamFeedbackPitch::get_name(char* text, int capacity) const { copy_text(text, "Fdbk Freq", capacity); }
void ParamFeedbackPitch::get_unit(char* text, int capacity) const { copy_text(text, "Hz", capacity); }
double ParamFeedbackPitch::conv_norm_to_value(float norm) const {
  return 16.0 * std::pow(64.0, static_cast<double>(norm));
}
float ParamFeedbackPitch::conv_value_to_norm(double value) const {
  return static_cast<float>(std::log2(value / 16.0) / 6.0);
}
void ParamFeedbackPitch::conv_value_to_text(char* text, int capacity, double value) const {
  write_frequency_text(text, capacity, value);
}
double ParamFeedbackPitch::conv_text_to_value(const char* text, bool& ok) const {
  double hz = 0.0;
  if (!read_param_double(text, "%lf", hz)) {
    return 0.0;
  }
  ok = true;
  return clamp_param(hz, 16.0, 1024.0);
}
