// brakmorph info: what a plug-in declares about itself.
#include <cmath>
#include <cstdio>
#include <iostream>
#include <sstream>

#include "cli/command_args.h"
#include "cli/commands.h"
#include "cli/hosted_plugin.h"
#include "cli/json_text.h"

namespace plugcore {
namespace {

struct PinInfo {
  bool known = false;
  std::string label;
  bool active = false;
  bool stereo = false;
};

struct ParamInfo {
  std::string name, label, display;
  float value = 0.0f;
  bool automatable = false;
  bool has_properties = false;
  bool is_switch = false;
  bool has_range = false;
  int min_integer = 0, max_integer = 0;
  bool stepped = false;
  bool can_ramp = false;
};

struct PluginInfo {
  std::string path, name, vendor, product;
  int32_t unique_id = 0, version = 0, flags = 0, initial_delay = 0;
  std::vector<PinInfo> inputs, outputs;
  std::vector<ParamInfo> params;
  std::vector<std::string> programs;
};

PinInfo read_pin(HostedPlugin& plugin, bool input, int index) {
  PinInfo pin;
  VstPinProperties properties;
  if (plugin.pin_properties(input, index, properties)) {
    pin.known = true;
    pin.label = properties.label;
    pin.active = (properties.flags & kVstPinIsActive) != 0;
    pin.stereo = (properties.flags & kVstPinIsStereo) != 0;
  }
  return pin;
}

ParamInfo read_param(HostedPlugin& plugin, int index) {
  ParamInfo param;
  param.name = plugin.param_name(index);
  param.label = plugin.param_label(index);
  param.display = plugin.param_display(index);
  param.value = plugin.get_norm(index);
  param.automatable = plugin.can_be_automated(index);
  VstParameterProperties properties;
  if (plugin.param_properties(index, properties)) {
    param.has_properties = true;
    param.is_switch = (properties.flags & kVstParameterIsSwitch) != 0;
    param.has_range = (properties.flags & kVstParameterUsesIntegerMinMax) != 0;
    param.min_integer = properties.minInteger;
    param.max_integer = properties.maxInteger;
    param.stepped = param.is_switch || param.has_range ||
                    (properties.flags & (kVstParameterUsesIntStep | kVstParameterUsesFloatStep)) != 0;
    param.can_ramp = (properties.flags & kVstParameterCanRamp) != 0;
  }
  return param;
}

PluginInfo gather(HostedPlugin& plugin) {
  PluginInfo info;
  AEffect* effect = plugin.effect();
  info.path = plugin.path();
  info.name = plugin.effect_name();
  info.vendor = plugin.vendor_string();
  info.product = plugin.product_string();
  info.unique_id = effect->uniqueID;
  info.version = effect->version;
  info.flags = effect->flags;
  info.initial_delay = effect->initialDelay;
  for (int i = 0; i < plugin.num_inputs(); ++i) info.inputs.push_back(read_pin(plugin, true, i));
  for (int i = 0; i < plugin.num_outputs(); ++i) info.outputs.push_back(read_pin(plugin, false, i));
  for (int i = 0; i < plugin.num_params(); ++i) info.params.push_back(read_param(plugin, i));
  for (int i = 0; i < plugin.num_programs(); ++i) info.programs.push_back(plugin.program_name(i));
  return info;
}

std::string kind_text(const ParamInfo& param) {
  if (!param.has_properties) return "";
  if (param.is_switch) return "switch";
  if (param.has_range) {
    return "integer " + std::to_string(param.min_integer) + ".." + std::to_string(param.max_integer);
  }
  return param.stepped ? "stepped" : "continuous";
}

std::string pin_text(const PinInfo& pin) {
  if (!pin.known) return "(no properties)";
  std::string text = pin.label;
  text += pin.active ? " [active" : " [inactive";
  text += pin.stereo ? ", stereo]" : "]";
  return text;
}

void print_text(const PluginInfo& info) {
  std::ostringstream out;
  out << "Plug-in:     " << info.path << "\n";
  out << "Name:        " << info.name << "\n";
  out << "Vendor:      " << info.vendor << "\n";
  out << "Product:     " << info.product << "\n";
  out << "Unique ID:   '" << four_char_code(info.unique_id) << "' (" << info.unique_id << ")\n";
  out << "Version:     " << info.version << "\n";
  out << "Flags:      ";
  for (const std::string& name : effect_flag_names(info.flags)) out << " " << name;
  out << "\n";
  out << "Latency:     " << info.initial_delay << " samples\n";
  out << "Inputs:      " << info.inputs.size() << "\n";
  for (size_t i = 0; i < info.inputs.size(); ++i) {
    out << "  " << i << "  " << pin_text(info.inputs[i]) << "\n";
  }
  out << "Outputs:     " << info.outputs.size() << "\n";
  for (size_t i = 0; i < info.outputs.size(); ++i) {
    out << "  " << i << "  " << pin_text(info.outputs[i]) << "\n";
  }
  out << "Parameters:  " << info.params.size() << "\n";
  for (size_t i = 0; i < info.params.size(); ++i) {
    const ParamInfo& param = info.params[i];
    char line[512];
    std::snprintf(line, sizeof(line), "  %3zu  %-22s %-14s %-8s %s%s%s", i, param.name.c_str(),
                  param.display.c_str(), param.label.c_str(),
                  param.automatable ? "automatable" : "fixed", kind_text(param).empty() ? "" : ", ",
                  kind_text(param).c_str());
    out << line << "\n";
  }
  out << "Programs:    " << info.programs.size() << "\n";
  for (size_t i = 0; i < info.programs.size(); ++i) {
    out << "  " << i << "  " << info.programs[i] << "\n";
  }
  std::cout << out.str();
}

std::string json_number(double value) {
  if (!std::isfinite(value)) return "null";
  char text[32];
  std::snprintf(text, sizeof(text), "%.9g", value);
  return text;
}

const char* json_bool(bool value) { return value ? "true" : "false"; }

void append_pins(std::ostringstream& out, const std::vector<PinInfo>& pins) {
  out << "[";
  for (size_t i = 0; i < pins.size(); ++i) {
    const PinInfo& pin = pins[i];
    out << (i ? "," : "") << "{\"index\":" << i << ",\"label\":"
        << (pin.known ? basic::json_quote(pin.label) : "null")
        << ",\"active\":" << json_bool(pin.active) << ",\"stereo\":" << json_bool(pin.stereo)
        << "}";
  }
  out << "]";
}

void print_json(const PluginInfo& info) {
  std::ostringstream out;
  out << "{\"path\":" << basic::json_quote(info.path) << ",\"name\":" << basic::json_quote(info.name)
      << ",\"vendor\":" << basic::json_quote(info.vendor)
      << ",\"product\":" << basic::json_quote(info.product)
      << ",\"unique_id\":" << basic::json_quote(four_char_code(info.unique_id))
      << ",\"unique_id_number\":" << info.unique_id << ",\"version\":" << info.version
      << ",\"flags_value\":" << info.flags << ",\"flags\":[";
  const auto flags = effect_flag_names(info.flags);
  for (size_t i = 0; i < flags.size(); ++i) out << (i ? "," : "") << basic::json_quote(flags[i]);
  out << "],\"initial_delay\":" << info.initial_delay << ",\"num_inputs\":" << info.inputs.size()
      << ",\"num_outputs\":" << info.outputs.size() << ",\"inputs\":";
  append_pins(out, info.inputs);
  out << ",\"outputs\":";
  append_pins(out, info.outputs);
  out << ",\"parameters\":[";
  for (size_t i = 0; i < info.params.size(); ++i) {
    const ParamInfo& param = info.params[i];
    out << (i ? "," : "") << "{\"index\":" << i << ",\"name\":" << basic::json_quote(param.name)
        << ",\"label\":" << basic::json_quote(param.label)
        << ",\"display\":" << basic::json_quote(param.display)
        << ",\"value\":" << json_number(param.value)
        << ",\"automatable\":" << json_bool(param.automatable) << ",\"properties\":";
    if (!param.has_properties) {
      out << "null";
    } else {
      out << "{\"switch\":" << json_bool(param.is_switch) << ",\"stepped\":"
          << json_bool(param.stepped) << ",\"can_ramp\":" << json_bool(param.can_ramp)
          << ",\"integer_range\":";
      if (param.has_range) {
        out << "[" << param.min_integer << "," << param.max_integer << "]";
      } else {
        out << "null";
      }
      out << "}";
    }
    out << "}";
  }
  out << "],\"programs\":[";
  for (size_t i = 0; i < info.programs.size(); ++i) {
    out << (i ? "," : "") << "{\"index\":" << i
        << ",\"name\":" << basic::json_quote(info.programs[i]) << "}";
  }
  out << "]}\n";
  std::cout << out.str();
}

}  // namespace

int run_info(basic::ArgReader& args) {
  std::string plugin_path = default_plugin_path();
  bool json = false;
  while (!args.done()) {
    const std::string option = args.next();
    if (option == "--plugin") {
      plugin_path = args.value(option);
    } else if (option == "--json") {
      json = true;
    } else {
      throw basic::UsageError("info: unknown option " + option);
    }
  }
  HostedPlugin plugin(plugin_path, 48000.0, 512);
  const PluginInfo info = gather(plugin);
  if (json) {
    print_json(info);
  } else {
    print_text(info);
  }
  return 0;
}

}  // namespace plugcore
