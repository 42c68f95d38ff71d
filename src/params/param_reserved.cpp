#include "params/param_reserved.h"

#include <cstdio>

#include "params/param_round.h"
#include "params/text_copy.h"

namespace plugcore {

void ParamReserved::get_name(char* text, int capacity) const { copy_text(text, "Reserved", capacity); }

void ParamReserved::get_unit(char* text, int capacity) const { copy_text(text, "", capacity); }

double ParamReserved::conv_norm_to_value(float norm) const { return norm; }

float ParamReserved::conv_value_to_norm(double value) const { return static_cast<float>(value); }

void ParamReserved::conv_value_to_text(char* text, int capacity, double value) const {
  // Inside the window "%lf" stays short; outside it an integer keeps the text
  // bounded before the cut (a "%lf" of 1e300 would be hundreds of digits).
  char full[64];
  if (value > -999.5 && value < 9999.5) {
    std::snprintf(full, sizeof(full), "%lf", value);
  } else {
    std::snprintf(full, sizeof(full), "%d", round_half_up_int(value));
  }
  full[6] = '\0';
  copy_text(text, full, capacity);
}

double ParamReserved::conv_text_to_value(const char* text, bool& ok) const {
  double value = 0.0;
  if (text == nullptr || std::sscanf(text, "%lf", &value) != 1) {
    return 0.0;
  }
  ok = true;
  if (!(value >= 0.0)) {
    return 0.0;
  }
  return value > 1.0 ? 1.0 : value;
}

}  // namespace plugcore
