#include "cli/hosted_plugin.h"

#include <cstring>
#include <stdexcept>

namespace plugcore {
namespace {

using EntryFunction = AEffect*(VST2_CALL*)(Vst2HostCallback);

// Plug-ins often write past the documented text capacities; a generous,
// zeroed buffer that is terminated afterwards keeps that harmless.
constexpr size_t kTextBuffer = 512;

struct FlagName {
  int32_t flag;
  const char* name;
};

const FlagName kFlagNames[] = {
    {effFlagsHasEditor, "HasEditor"},
    {effFlagsHasClip, "HasClip"},
    {effFlagsHasVu, "HasVu"},
    {effFlagsCanMono, "CanMono"},
    {effFlagsCanReplacing, "CanReplacing"},
    {effFlagsProgramChunks, "ProgramChunks"},
    {effFlagsIsSynth, "IsSynth"},
    {effFlagsNoSoundInStop, "NoSoundInStop"},
    {effFlagsExtIsAsync, "ExtIsAsync"},
    {effFlagsExtHasBuffer, "ExtHasBuffer"},
    {effFlagsCanDoubleReplacing, "CanDoubleReplacing"},
};

}  // namespace

HostedPlugin::HostedPlugin(const std::string& path, double sample_rate, int block_size,
                           int connected_inputs, int connected_outputs)
    : path_(path), context_(std::make_unique<HostCallbackContext>()) {
  context_->sample_rate = sample_rate;
  context_->block_size = block_size;
  context_->connected_inputs = connected_inputs;
  context_->connected_outputs = connected_outputs;

  std::string error;
  module_ = sys::open_dynamic_module(path, error);
  if (!module_) {
    throw std::runtime_error("cannot load plug-in " + path + ": " + error);
  }
  void* entry = module_->find_symbol("VSTPluginMain");
  if (entry == nullptr) {
    entry = module_->find_symbol("main");
  }
  if (entry == nullptr) {
    throw std::runtime_error("plug-in " + path + " exports neither VSTPluginMain nor main");
  }
  bind_pending_context(context_.get());
  effect_ = reinterpret_cast<EntryFunction>(entry)(host_callback);
  bind_pending_context(nullptr);
  if (effect_ == nullptr) {
    throw std::runtime_error("plug-in " + path + " refused to load (entry returned null)");
  }
  if (effect_->magic != kVstMagic) {
    effect_ = nullptr;  // not a record we may call into
    throw std::runtime_error("plug-in " + path + " returned a record without the 'VstP' magic");
  }
  bind_context(effect_, context_.get());
  dispatch(effOpen);
  opened_ = true;
  dispatch(effSetSampleRate, 0, 0, nullptr, static_cast<float>(sample_rate));
  dispatch(effSetBlockSize, 0, block_size);
}

HostedPlugin::~HostedPlugin() {
  if (effect_ != nullptr) {
    if (resumed_) {
      suspend();
    }
    if (opened_) {
      dispatch(effClose);  // the plug-in deletes itself here
    }
    unbind_context(effect_);
  }
  module_.reset();
}

intptr_t HostedPlugin::dispatch(int32_t opcode, int32_t index, intptr_t value, void* ptr,
                                float opt) {
  return effect_->dispatcher(effect_, opcode, index, value, ptr, opt);
}

std::string HostedPlugin::text_query(int32_t opcode, int32_t index) {
  char buffer[kTextBuffer] = {0};
  dispatch(opcode, index, 0, buffer);
  buffer[kTextBuffer - 1] = '\0';
  return buffer;
}

std::string HostedPlugin::param_name(int index) { return text_query(effGetParamName, index); }
std::string HostedPlugin::param_label(int index) { return text_query(effGetParamLabel, index); }
std::string HostedPlugin::param_display(int index) {
  return text_query(effGetParamDisplay, index);
}

std::vector<std::string> HostedPlugin::param_names() {
  std::vector<std::string> names;
  for (int i = 0; i < num_params(); ++i) {
    names.push_back(param_name(i));
  }
  return names;
}

std::string HostedPlugin::program_name(int index) {
  char buffer[kTextBuffer] = {0};
  if (dispatch(effGetProgramNameIndexed, index, -1, buffer) == 0) {
    return std::string();
  }
  buffer[kTextBuffer - 1] = '\0';
  return buffer;
}

std::string HostedPlugin::effect_name() { return text_query(effGetEffectName, 0); }
std::string HostedPlugin::vendor_string() { return text_query(effGetVendorString, 0); }
std::string HostedPlugin::product_string() { return text_query(effGetProductString, 0); }

bool HostedPlugin::pin_properties(bool input, int index, VstPinProperties& properties) {
  std::memset(&properties, 0, sizeof(properties));
  const intptr_t answer =
      dispatch(input ? effGetInputProperties : effGetOutputProperties, index, 0, &properties);
  properties.label[sizeof(properties.label) - 1] = '\0';
  properties.shortLabel[sizeof(properties.shortLabel) - 1] = '\0';
  return answer != 0;
}

bool HostedPlugin::param_properties(int index, VstParameterProperties& properties) {
  std::memset(&properties, 0, sizeof(properties));
  const intptr_t answer = dispatch(effGetParameterProperties, index, 0, &properties);
  properties.label[sizeof(properties.label) - 1] = '\0';
  properties.shortLabel[sizeof(properties.shortLabel) - 1] = '\0';
  properties.categoryLabel[sizeof(properties.categoryLabel) - 1] = '\0';
  return answer != 0;
}

bool HostedPlugin::can_be_automated(int index) { return dispatch(effCanBeAutomated, index) != 0; }

void HostedPlugin::set_program(int index) { dispatch(effSetProgram, 0, index); }

bool HostedPlugin::string_to_param(int index, const std::string& text) {
  std::vector<char> buffer(text.begin(), text.end());
  buffer.push_back('\0');
  return dispatch(effString2Parameter, index, 0, buffer.data()) != 0;
}

void HostedPlugin::set_norm(int index, float value) { effect_->setParameter(effect_, index, value); }
float HostedPlugin::get_norm(int index) { return effect_->getParameter(effect_, index); }

void HostedPlugin::resume() {
  dispatch(effMainsChanged, 0, 1);
  resumed_ = true;
}

void HostedPlugin::suspend() {
  dispatch(effMainsChanged, 0, 0);
  resumed_ = false;
}

bool HostedPlugin::supports(ProcessMode mode) const {
  if (mode == ProcessMode::replacing) {
    return (effect_->flags & effFlagsCanReplacing) != 0 && effect_->processReplacing != nullptr;
  }
  return effect_->process != nullptr;
}

void HostedPlugin::process(float** inputs, float** outputs, int frames, ProcessMode mode,
                           int output_count) {
  if (mode == ProcessMode::replacing) {
    effect_->processReplacing(effect_, inputs, outputs, frames);
  } else {
    for (int channel = 0; channel < output_count; ++channel) {
      std::memset(outputs[channel], 0, sizeof(float) * static_cast<size_t>(frames));
    }
    effect_->process(effect_, inputs, outputs, frames);
  }
  context_->sample_pos += frames;
}

std::string four_char_code(int32_t id) {
  const uint32_t bits = static_cast<uint32_t>(id);
  std::string code;
  for (int shift = 24; shift >= 0; shift -= 8) {
    const char c = static_cast<char>((bits >> shift) & 0xFF);
    code += (c >= 32 && c < 127) ? c : '?';
  }
  return code;
}

std::vector<std::string> effect_flag_names(int32_t flags) {
  std::vector<std::string> names;
  for (const FlagName& entry : kFlagNames) {
    if ((flags & entry.flag) != 0) {
      names.push_back(entry.name);
    }
  }
  return names;
}

}  // namespace plugcore
