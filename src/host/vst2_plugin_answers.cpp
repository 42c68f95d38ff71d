// The plug-in's answers to the host's questions: texts, pins, properties, canDo.
#include <cctype>
#include <cmath>
#include <cstdio>
#include <cstring>
#include <exception>
#include <string>

#include "host/dsp_interface.h"
#include "host/vst2_plugin.h"
#include "params/normalized_param_interface.h"
#include "params/param_round.h"
#include "params/pin_group.h"
#include "params/text_copy.h"

namespace plugcore {

namespace {

constexpr int kParamTextCapacity = 23;  // hosts reserve little room for these texts
constexpr int kEffectNameCapacity = 31;
constexpr int kProductCapacity = 64;
constexpr int kPinLabelCapacity = 63;
constexpr int kShortLabelCapacity = 8;

std::string lower(std::string text) {
  for (char& c : text) {
    c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
  }
  return text;
}

bool fill_pin(DspInterface& dsp, bool output, int32_t index, VstPinProperties* properties) {
  int host_pin = 0;
  const int groups = output ? dsp.get_nbr_output_groups() : dsp.get_nbr_input_groups();
  for (int g = 0; g < groups; ++g) {
    const PinGroup& group = output ? dsp.use_output_group(g) : dsp.use_input_group(g);
    for (size_t p = 0; p < group.pins.size() && p < 2; ++p, ++host_pin) {
      if (host_pin != index) {
        continue;
      }
      std::memset(properties, 0, sizeof(*properties));
      properties->flags = group.pins.size() == 2 ? (kVstPinIsActive | kVstPinIsStereo) : kVstPinIsActive;
      copy_text(properties->label, group.pins[p].c_str(), kPinLabelCapacity);
      return true;
    }
  }
  return false;
}

}  // namespace

void Vst2Plugin::getProgramName(char* name) {
  if (cur_program_ < 0 || cur_program_ >= bank_.get_nbr_programs()) {
    copy_text(name, "", kParamTextCapacity);
    return;
  }
  copy_text(name, bank_.use_program(cur_program_).get_name().c_str(), kParamTextCapacity);
}

void Vst2Plugin::getParameterLabel(int32_t index, char* label) {
  if (valid_param(index)) {
    dsp_->use_param(index).get_unit(label, kParamTextCapacity);
  }
}

void Vst2Plugin::getParameterDisplay(int32_t index, char* text) {
  if (valid_param(index)) {
    NormalizedParamInterface& param = dsp_->use_param(index);
    param.conv_value_to_text(text, kParamTextCapacity, param.get_value());
  }
}

void Vst2Plugin::getParameterName(int32_t index, char* text) {
  if (valid_param(index)) {
    dsp_->use_param(index).get_name(text, kParamTextCapacity);
  }
}

bool Vst2Plugin::canParameterBeAutomated(int32_t index) {
  if (!valid_param(index)) {
    return true;
  }
  return dsp_->use_param(index).get_priority() <= automation_threshold_;
}

bool Vst2Plugin::string2parameter(int32_t index, const char* text) {
  if (text == nullptr) {
    return true;
  }
  if (!valid_param(index)) {
    return false;
  }
  try {
    NormalizedParamInterface& param = dsp_->use_param(index);
    bool ok = false;
    const double value = param.conv_text_to_value(text, ok);
    if (ok) {
      setParameter(index, param.conv_value_to_norm(value));
    }
    return ok;
  } catch (const std::exception&) {
    return false;
  }
}

bool Vst2Plugin::getProgramNameIndexed(int32_t category, int32_t index, char* text) {
  if (index < 0 || index >= bank_.get_nbr_programs()) {
    return false;
  }
  copy_text(text, bank_.use_program(index).get_name().c_str(), kProductCapacity);
  return true;
}

bool Vst2Plugin::copyProgram(int32_t destination) {
  if (destination < 0 || destination >= bank_.get_nbr_programs() || cur_program_ < 0 ||
      cur_program_ >= bank_.get_nbr_programs()) {
    return false;
  }
  const ProgramSlot current = bank_.use_program(cur_program_);
  bank_.set_program(destination, current);
  return true;
}

bool Vst2Plugin::getInputProperties(int32_t index, VstPinProperties* properties) {
  return fill_pin(*dsp_, false, index, properties);
}

bool Vst2Plugin::getOutputProperties(int32_t index, VstPinProperties* properties) {
  return fill_pin(*dsp_, true, index, properties);
}

int32_t Vst2Plugin::getPlugCategory() {
  struct Entry {
    const char* name;
    int32_t category;
  };
  static const Entry kCategories[] = {
      {"", kPlugCategEffect},          {"effect", kPlugCategEffect},     {"hybrid", kPlugCategEffect},
      {"instrument", kPlugCategSynth}, {"analyser", kPlugCategAnalysis},
  };
  const std::string category = lower(dsp_->get_property_str("plugin_category"));
  for (const Entry& entry : kCategories) {
    if (category == entry.name) {
      return entry.category;
    }
  }
  return kPlugCategUnknown;
}

bool Vst2Plugin::getEffectName(char* name) {
  copy_text(name, dsp_->get_property_str("plugin_name").c_str(), kEffectNameCapacity);
  return true;
}

bool Vst2Plugin::getVendorString(char* text) {
  copy_text(text, "Velmora", kProductCapacity);
  return true;
}

bool Vst2Plugin::getProductString(char* text) {
  char product[256];
  std::snprintf(product, sizeof(product), "Velmora %s %.2lf", dsp_->get_property_str("plugin_name").c_str(),
                dsp_->get_property_num("plugin_version"));
  copy_text(text, product, kProductCapacity);
  return true;
}

int32_t Vst2Plugin::getVendorVersion() {
  const double version = dsp_->get_property_num("plugin_version");
  const int hundredths = plugcore::round_half_up_int(version * 100.0);
  const int major = hundredths / 100;
  const int d1 = (hundredths / 10) % 10;
  const int d2 = hundredths % 10;
  return (major * 16 + d1) * 16 + d2;
}

int32_t Vst2Plugin::canDo(const char* text) {
  static const char* const kMidiAbilities[] = {"sendVstMidiEvent", "sendVstEvents", "receiveVstMidiEvent",
                                               "receiveVstEvents"};
  for (const char* ability : kMidiAbilities) {
    if (std::strcmp(text, ability) == 0) {
      return midi_mgr_ != nullptr ? 1 : -1;
    }
  }
  if (std::strcmp(text, "receiveVstTimeInfo") == 0) {
    return 1;
  }
  return 0;
}

bool Vst2Plugin::getParameterProperties(int32_t index, VstParameterProperties* p) {
  if (!valid_param(index)) {
    return false;
  }
  std::memset(p, 0, sizeof(*p));
  NormalizedParamInterface& param = dsp_->use_param(index);
  param.get_name(p->label, 64);
  copy_text(p->shortLabel, p->label, kShortLabelCapacity);
  if (param.get_type() == 1) {
    int lo = plugcore::round_half_up_int(param.conv_norm_to_value(0.0f));
    int hi = plugcore::round_half_up_int(param.conv_norm_to_value(1.0f));
    if (hi < lo) {
      std::swap(lo, hi);
    }
    if (hi - lo == 1) {
      p->flags |= kVstParameterIsSwitch;
    } else {
      p->minInteger = lo;
      p->maxInteger = hi;
      p->flags |= kVstParameterUsesIntegerMinMax;
    }
  } else {
    p->flags |= kVstParameterCanRamp;
  }
  return true;
}

}  // namespace plugcore
