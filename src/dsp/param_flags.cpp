#include "dsp/param_flags.h"

#include "dsp/param_text.h"
#include "params/text_copy.h"

using plugcore::copy_text;

void ParamStereoBoostingFlag::get_name(char* text, int capacity) const { copy_text(text, "Stereo Boost", capacity); }
void ParamStereoBoostingFlag::get_unit(char* text, int capacity) const { copy_text(text, "", capacity); }
double ParamStereoBoostingFlag::conv_norm_to_value(float norm) const { return norm >= 0.5f ? 1.0 : 0.0; }
float ParamStereoBoostingFlag::conv_value_to_norm(double value) const { return value >= 0.5 ? 1.0f : 0.0f; }
void ParamStereoBoostingFlag::conv_value_to_text(char* text, int capacity, double value) const {
  write_switch_text(text, capacity, value >= 0.5);
}
double ParamStereoBoostingFlag::conv_text_to_value(const char* text, bool& ok) const {
  return read_switch_text(text, ok);
}

void ParamOverSamplingFlag::get_name(char* text, int capacity) const { copy_text(text, "Oversampling", capacity); }
void ParamOverSamplingFlag::get_unit(char* text, int capacity) const { copy_text(text, "", capacity); }
double ParamOverSamplingFlag::conv_norm_to_value(float norm) const { return norm >= 0.5f ? 1.0 : 0.0; }
float ParamOverSamplingFlag::conv_value_to_norm(double value) const { return value >= 0.5 ? 1.0f : 0.0f; }
void ParamOverSamplingFlag::conv_value_to_text(char* text, int capacity, double value) const {
  write_switch_text(text, capacity, value >= 0.5);
}
double ParamOverSamplingFlag::conv_text_to_value(const char* text, bool& ok) const {
  return read_switch_text(text, ok);
}
