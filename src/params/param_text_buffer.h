#pragma once

#include <string>

#include "params/normalized_param_interface.h"

namespace plugcore {

// The texts the editor shows for a parameter, through buffers of 128 characters.
constexpr int kParamTextCapacity = 128;

inline std::string param_value_text(const NormalizedParamInterface& param, double value) {
  char text[kParamTextCapacity] = {};
  param.conv_value_to_text(text, kParamTextCapacity, value);
  text[kParamTextCapacity - 1] = '\0';
  return text;
}

inline std::string param_name_text(const NormalizedParamInterface& param) {
  char text[kParamTextCapacity] = {};
  param.get_name(text, kParamTextCapacity);
  text[kParamTextCapacity - 1] = '\0';
  return text;
}

inline std::string param_unit_text(const NormalizedParamInterface& param) {
  char text[kParamTextCapacity] = {};
  param.get_unit(text, kParamTextCapacity);
  text[kParamTextCapacity - 1] = '\0';
  return text;
}

}  // namespace plugcore
