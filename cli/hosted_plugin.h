// One plug-in instance loaded and driven the way a host drives it: load the
// module, call its entry with our callback, open it, and close and unload it
// in the reverse order.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "cli/dynamic_module_interface.h"
#include "cli/host_callback.h"

namespace plugcore {

enum class ProcessMode { replacing, adding };

class HostedPlugin {
 public:
  // Loads, checks the magic, then effOpen, effSetSampleRate, effSetBlockSize.
  // Throws std::runtime_error with a one-line reason on any failure.
  HostedPlugin(const std::string& path, double sample_rate, int block_size,
               int connected_inputs = 2, int connected_outputs = 2);
  ~HostedPlugin();
  HostedPlugin(const HostedPlugin&) = delete;
  HostedPlugin& operator=(const HostedPlugin&) = delete;

  const std::string& path() const { return path_; }
  AEffect* effect() { return effect_; }
  HostCallbackContext& context() { return *context_; }
  intptr_t dispatch(int32_t opcode, int32_t index = 0, intptr_t value = 0, void* ptr = nullptr,
                    float opt = 0.0f);

  int num_params() const { return effect_->numParams; }
  int num_programs() const { return effect_->numPrograms; }
  int num_inputs() const { return effect_->numInputs; }
  int num_outputs() const { return effect_->numOutputs; }
  int32_t flags() const { return effect_->flags; }

  std::string param_name(int index);
  std::string param_label(int index);
  std::string param_display(int index);
  std::vector<std::string> param_names();
  std::string program_name(int index);  // effGetProgramNameIndexed; empty when refused
  std::string effect_name();
  std::string vendor_string();
  std::string product_string();
  bool pin_properties(bool input, int index, VstPinProperties& properties);
  bool param_properties(int index, VstParameterProperties& properties);
  bool can_be_automated(int index);

  void set_program(int index);
  bool string_to_param(int index, const std::string& text);
  void set_norm(int index, float value);
  float get_norm(int index);

  // effMainsChanged 1 / 0; the destructor suspends a resumed instance.
  void resume();
  void suspend();
  bool resumed() const { return resumed_; }

  // One call of the chosen entry point. Adding mode zeroes the outputs first,
  // so both modes deliver the same block.
  void process(float** inputs, float** outputs, int frames, ProcessMode mode, int output_count);
  bool supports(ProcessMode mode) const;

 private:
  std::string text_query(int32_t opcode, int32_t index);

  std::string path_;
  std::unique_ptr<HostCallbackContext> context_;
  std::unique_ptr<sys::DynamicModuleInterface> module_;
  AEffect* effect_ = nullptr;
  bool opened_ = false;
  bool resumed_ = false;
};

// "<dir of this executable>/../vst/Brakmorph.so" on Linux; implemented per platform.
std::string default_plugin_path();

// The four characters of a unique identifier, '?' for unprintable bytes.
std::string four_char_code(int32_t id);

// Names of the flags set in an effect's flags field.
std::vector<std::string> effect_flag_names(int32_t flags);

}  // namespace plugcore
