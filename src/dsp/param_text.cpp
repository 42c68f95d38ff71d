#include "dsp/param_text.h"

#include <cctype>
#include <cmath>
#include <cstdio>
#include <cstring>

#include "params/param_round.h"
#include "params/text_copy.h"

std::string format_param_text(const char* format, double value) {
  int length = std::snprintf(nullptr, 0, format, value);
  if (length <= 0) {
    return std::string();
  }
  std::string out(static_cast<size_t>(length) + 1, '\0');
  std::snprintf(&out[0], out.size(), format, value);
  out.resize(static_cast<size_t>(length));
  return out;
}

std::string format_param_int(const char* format, int value) {
  char buffer[64];
  std::snprintf(buffer, sizeof(buffer), format, value);
  return std::string(buffer);
}

void write_param_text(char* text, int capacity, const std::string& full, int width) {
  std::string cut = full.substr(0, static_cast<size_t>(width));
  plugcore::copy_text(text, cut.c_str(), capacity);
}

bool param_text_contains(const char* text, const char* word) {
  if (text == nullptr || word == nullptr) {
    return false;
  }
  size_t text_length = std::strlen(text);
  size_t word_length = std::strlen(word);
  if (word_length > text_length) {
    return false;
  }
  for (size_t start = 0; start + word_length <= text_length; ++start) {
    size_t i = 0;
    while (i < word_length && std::tolower(static_cast<unsigned char>(text[start + i])) ==
                                  std::tolower(static_cast<unsigned char>(word[i]))) {
      ++i;
    }
    if (i == word_length) {
      return true;
    }
  }
  return false;
}

bool read_param_double(const char* text, const char* format, double& value) {
  if (text == nullptr) {
    return false;
  }
  return std::sscanf(text, format, &value) == 1;
}

double clamp_param(double value, double low, double high) {
  // A NaN from the scan ("nan") lands on the low end rather than passing through.
  if (!(value >= low)) {
    return low;
  }
  return value > high ? high : value;
}

void write_frequency_text(char* text, int capacity, double hz) {
  std::string full;
  if (hz >= 999.5 || hz <= -99.5) {
    full = format_param_int("%d", plugcore::round_half_up_int(hz));
  } else {
    full = format_param_text("%lf", hz);
  }
  write_param_text(text, capacity, full, 5);
}

void write_percent_text(char* text, int capacity, double fraction) {
  write_param_text(text, capacity, format_param_text("%.1f", 100.0 * fraction), 5);
}

void write_gain_db_text(char* text, int capacity, double gain) {
  if (gain <= 1e-5) {
    write_param_text(text, capacity, "-oo", 5);
    return;
  }
  write_param_text(text, capacity, format_param_text("%.1f", 20.0 * std::log10(gain)), 5);
}

void write_switch_text(char* text, int capacity, bool on) { plugcore::copy_text(text, on ? "On" : "Off", capacity); }

double read_switch_text(const char* text, bool& ok) {
  if (param_text_contains(text, "on")) {
    ok = true;
    return 1.0;
  }
  if (param_text_contains(text, "off")) {
    ok = true;
    return 0.0;
  }
  double number = 0.0;
  if (read_param_double(text, "%lf", number)) {
    ok = true;
    return number >= 0.5 ? 1.0 : 0.0;
  }
  return 0.0;
}
