#include "dsp/param_split_freq.h"

#include <cmath>

#include "dsp/param_text.h"
#include "params/text_copy.h"

using plugcore::copy_text;

void ParamBandSplitFrq::get_name_prefix(char* text, int capacity) const { copy_text(text, "B", capacity); }
void ParamBandSplitFrq::get_name_suffix(char* text, int capacity) const { copy_text(text, " Upper Freq", capacity); }
void ParamBandSplitFrq::get_unit(char* text, int capacity) const { copy_text(text, "Hz", capacity); }
double ParamBandSplitFrq::conv_norm_to_value(float norm) const {
  return 20.0 * std::pow(1024.0, static_cast<double>(norm));
}
float ParamBandSplitFrq::conv_value_to_norm(double value) const {
  return static_cast<float>(std::log2(value / 20.0) / 10.0);
}
void ParamBandSplitFrq::conv_value_to_text(char* text, int capacity, double value) const {
  write_frequency_text(text, capacity, value);
}
double ParamBandSplitFrq::conv_text_to_value(const char* text, bool& ok) const {
  double hz = 0.0;
  if (!read_param_double(text, "%lf", hz)) {
    return 0.0;
  }
  ok = true;
  return clamp_param(hz, 20.0, 20480.0);
}
