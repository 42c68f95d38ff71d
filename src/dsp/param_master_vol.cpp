#include "dsp/param_master_vol.h"

#include <cmath>

#include "dsp/param_text.h"
#include "params/text_copy.h"

using plugcore::copy_text;

void ParamMasterVol::get_name(char* text, int capacity) const { copy_text(text, "Master Vol", capacity); }
void ParamMasterVol::get_unit(char* text, int capacity) const { copy_text(text, "dB", capacity); }
double ParamMasterVol::conv_norm_to_value(float norm) const {
  return 2.0 * (std::pow(64.0, static_cast<double>(norm)) - 1.0) / 63.0;
}
float ParamMasterVol::conv_value_to_norm(double value) const {
  return static_cast<float>(std::log(1.0 + 31.5 * value) / std::log(64.0));
}
void ParamMasterVol::conv_value_to_text(char* text, int capacity, double value) const {
  write_gain_db_text(text, capacity, value);
}
double ParamMasterVol::conv_text_to_value(const char* text, bool& ok) const {
  if (param_text_contains(text, "oo")) {
    ok = true;
    return 0.0;
  }
  double db = 0.0;
  if (!read_param_double(text, "%lf", db)) {
    return 0.0;
  }
  ok = true;
  return clamp_param(std::pow(10.0, db / 20.0), 0.0, 2.0);
}
