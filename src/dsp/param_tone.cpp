#include "dsp/param_tone.h"

#include <cmath>

#include "dsp/param_text.h"
#include "params/text_copy.h"

using plugcore::copy_text;

void ParamToneFrq::get_name(char* text, int capacity) const { copy_text(text, "Tone Freq", capacity); }
void ParamToneFrq::get_unit(char* text, int capacity) const { copy_text(text, "Hz", capacity); }
double ParamToneFrq::conv_norm_to_value(float norm) const { return 2000.0 * std::pow(4.0, static_cast<double>(norm)); }
float ParamToneFrq::conv_value_to_norm(double value) const {
  return static_cast<float>(std::log2(value / 2000.0) / 2.0);
}
void ParamToneFrq::conv_value_to_text(char* text, int capacity, double value) const {
  write_frequency_text(text, capacity, value);
}
double ParamToneFrq::conv_text_to_value(const char* text, bool& ok) const {
  double hz = 0.0;
  if (!read_param_double(text, "%lf", hz)) {
    return 0.0;
  }
  ok = true;
  return clamp_param(hz, 2000.0, 8000.0);
}

void ParamToneColor::get_name(char* text, int capacity) const { copy_text(text, "Tone Shape", capacity); }
void ParamToneColor::get_unit(char* text, int capacity) const { copy_text(text, "%", capacity); }
double ParamToneColor::conv_norm_to_value(float norm) const { return norm; }
float ParamToneColor::conv_value_to_norm(double value) const { return static_cast<float>(value); }
void ParamToneColor::conv_value_to_text(char* text, int capacity, double value) const {
  write_percent_text(text, capacity, value);
}
double ParamToneColor::conv_text_to_value(const char* text, bool& ok) const {
  double percent = 0.0;
  if (!read_param_double(text, "%lf", percent)) {
    return 0.0;
  }
  ok = true;
  return clamp_param(percent * 0.01, 0.0, 1.0);
}
