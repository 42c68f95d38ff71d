#include "dsp/param_band.h"

#include <cctype>
#include <cmath>
#include <cstdio>

#include "dsp/curve_names.h"
#include "dsp/param_text.h"
#include "params/param_round.h"
#include "params/text_copy.h"

using plugcore::copy_text;
using plugcore::round_half_up;
using plugcore::round_half_up_int;

// Character

void ParamCharacter::get_name_prefix(char* text, int capacity) const { copy_text(text, "B", capacity); }
void ParamCharacter::get_name_suffix(char* text, int capacity) const { copy_text(text, " Character", capacity); }
void ParamCharacter::get_unit(char* text, int capacity) const { copy_text(text, "%", capacity); }
double ParamCharacter::conv_norm_to_value(float norm) const { return norm; }
float ParamCharacter::conv_value_to_norm(double value) const { return static_cast<float>(value); }

void ParamCharacter::conv_value_to_text(char* text, int capacity, double value) const {
  std::string full;
  if (std::fabs(value - 0.5) <= 0.004) {
    full = "neutral";
  } else if (value > 0.5) {
    full = format_param_int("S %d", round_half_up_int(200.0 * (value - 0.5)));
  } else {
    full = format_param_int("P %d", round_half_up_int(200.0 * (0.5 - value)));
  }
  write_param_text(text, capacity, full, 7);
}

double ParamCharacter::conv_text_to_value(const char* text, bool& ok) const {
  char upper[31];
  copy_text(upper, text, static_cast<int>(sizeof(upper)));
  for (char& c : upper) {
    c = static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
  }
  double amount = 0.0;
  if (read_param_double(upper, "S%lf", amount)) {
    ok = true;
    return clamp_param(0.5 + 0.005 * amount, 0.5, 1.0);
  }
  if (read_param_double(upper, "P%lf", amount)) {
    ok = true;
    return clamp_param(0.5 - 0.005 * amount, 0.0, 0.5);
  }
  if (param_text_contains(upper, "n")) {
    ok = true;
    return 0.5;
  }
  return 0.0;
}

// Intensity

void ParamIntensity::get_name_prefix(char* text, int capacity) const { copy_text(text, "B", capacity); }
void ParamIntensity::get_name_suffix(char* text, int capacity) const { copy_text(text, " Intensity", capacity); }
void ParamIntensity::get_unit(char* text, int capacity) const { copy_text(text, "%", capacity); }
double ParamIntensity::conv_norm_to_value(float norm) const { return norm; }
float ParamIntensity::conv_value_to_norm(double value) const { return static_cast<float>(value); }
void ParamIntensity::conv_value_to_text(char* text, int capacity, double value) const {
  write_percent_text(text, capacity, value);
}
double ParamIntensity::conv_text_to_value(const char* text, bool& ok) const {
  double percent = 0.0;
  if (!read_param_double(text, "%lf", percent)) {
    return 0.0;
  }
  ok = true;
  return clamp_param(percent * 0.01, 0.0, 1.0);
}

// Dist Amnt

void ParamDistoAmount::get_name_prefix(char* text, int capacity) const { copy_text(text, "B", capacity); }
void ParamDistoAmount::get_name_suffix(char* text, int capacity) const { copy_text(text, " Dist Amnt", capacity); }
void ParamDistoAmount::get_unit(char* text, int capacity) const { copy_text(text, "dB", capacity); }
double ParamDistoAmount::conv_norm_to_value(float norm) const {
  return std::pow(10.0, 3.0 * static_cast<double>(norm) - 1.0);
}
float ParamDistoAmount::conv_value_to_norm(double value) const {
  return static_cast<float>(std::log10(value) / 3.0 + 1.0 / 3.0);
}

void ParamDistoAmount::conv_value_to_text(char* text, int capacity, double value) const {
  double db = 20.0 * std::log10(value);
  std::string full;
  if (db > 0.1) {
    full = format_param_text("+%f", db);
  } else if (db < -0.1) {
    full = format_param_text("%f", db);
  } else {
    // Near unity the level reads as a right-aligned zero.
    full = "    0";
  }
  write_param_text(text, capacity, full, 5);
}

double ParamDistoAmount::conv_text_to_value(const char* text, bool& ok) const {
  double db = 0.0;
  if (!read_param_double(text, "%lf", db)) {
    return 0.0;
  }
  ok = true;
  return clamp_param(std::pow(10.0, db / 20.0), 0.1, 100.0);
}

// Dist Type

void ParamDistoType::get_name_prefix(char* text, int capacity) const { copy_text(text, "B", capacity); }
void ParamDistoType::get_name_suffix(char* text, int capacity) const { copy_text(text, " Dist Type", capacity); }
void ParamDistoType::get_unit(char* text, int capacity) const { copy_text(text, "", capacity); }
double ParamDistoType::conv_norm_to_value(float norm) const { return round_half_up(12.0 * static_cast<double>(norm)); }
float ParamDistoType::conv_value_to_norm(double value) const { return static_cast<float>(round_half_up(value) / 12.0); }

void ParamDistoType::conv_value_to_text(char* text, int capacity, double value) const {
  int curve = round_half_up_int(value);
  // An out-of-range number shows the nearest curve rather than nothing.
  if (curve < 0) {
    curve = 0;
  } else if (curve >= kNbrDistortionCurves) {
    curve = kNbrDistortionCurves - 1;
  }
  copy_text(text, distortion_curve_name(curve), capacity);
}

double ParamDistoType::conv_text_to_value(const char* text, bool& ok) const {
  for (int curve = 0; curve < kNbrDistortionCurves; ++curve) {
    if (param_text_contains(text, distortion_curve_name(curve))) {
      ok = true;
      return curve;
    }
  }
  int number = 0;
  if (text == nullptr || std::sscanf(text, "%d", &number) != 1) {
    return 0.0;
  }
  ok = true;
  return clamp_param(number, 0.0, kNbrDistortionCurves - 1.0);
}

// Volume

void ParamBandVolume::get_name_prefix(char* text, int capacity) const { copy_text(text, "B", capacity); }
void ParamBandVolume::get_name_suffix(char* text, int capacity) const { copy_text(text, " Volume", capacity); }
void ParamBandVolume::get_unit(char* text, int capacity) const { copy_text(text, "dB", capacity); }
double ParamBandVolume::conv_norm_to_value(float norm) const {
  return 10.0 * (std::pow(100.0, static_cast<double>(norm)) - 1.0) / 99.0;
}
float ParamBandVolume::conv_value_to_norm(double value) const {
  return static_cast<float>(clamp_param(std::log10(1.0 + 9.9 * value) / 2.0, 0.0, 1.0));
}
void ParamBandVolume::conv_value_to_text(char* text, int capacity, double value) const {
  write_gain_db_text(text, capacity, value);
}
double ParamBandVolume::conv_text_to_value(const char* text, bool& ok) const {
  if (param_text_contains(text, "oo")) {
    ok = true;
    return 0.0;
  }
  double db = 0.0;
  if (!read_param_double(text, "%lf", db)) {
    return 0.0;
  }
  ok = true;
  return clamp_param(std::pow(10.0, db / 20.0), 0.0, 10.0);
}

// Solo

void ParamSolo::get_name_prefix(char* text, int capacity) const { copy_text(text, "B", capacity); }
void ParamSolo::get_name_suffix(char* text, int capacity) const { copy_text(text, " Solo", capacity); }
void ParamSolo::get_unit(char* text, int capacity) const { copy_text(text, "", capacity); }
double ParamSolo::conv_norm_to_value(float norm) const { return round_half_up(norm); }
float ParamSolo::conv_value_to_norm(double value) const { return static_cast<float>(round_half_up(value)); }
void ParamSolo::conv_value_to_text(char* text, int capacity, double value) const {
  write_switch_text(text, capacity, round_half_up(value) != 0.0);
}
double ParamSolo::conv_text_to_value(const char* text, bool& ok) const { return read_switch_text(text, ok); }
