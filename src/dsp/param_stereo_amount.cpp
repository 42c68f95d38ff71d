#include "dsp/param_stereo_amount.h"

#include <cmath>

#include "dsp/param_text.h"
#include "params/text_copy.h"

using plugcore::copy_text;

void ParamStereoAmount::get_name(char* text, int capacity) const { copy_text(text, "Stereo Phase", capacity); }
void ParamStereoAmount::get_unit(char* text, int capacity) const { copy_text(text, "ms", capacity); }
double ParamStereoAmount::conv_norm_to_value(float norm) const {
  return 0.01 * (std::pow(10.0, static_cast<double>(norm)) - 1.0) / 9.0;
}
float ParamStereoAmount::conv_value_to_norm(double value) const {
  return static_cast<float>(std::log10(1.0 + 900.0 * value));
}
void ParamStereoAmount::conv_value_to_text(char* text, int capacity, double value) const {
  write_param_text(text, capacity, format_param_text("%lf", 1000.0 * value), 5);
}
double ParamStereoAmount::conv_text_to_value(const char* text, bool& ok) const {
  double ms = 0.0;
  if (!read_param_double(text, "%lf", ms)) {
    return 0.0;
  }
  ok = true;
  return clamp_param(ms, 0.0, 10.0) * 0.001;
}
