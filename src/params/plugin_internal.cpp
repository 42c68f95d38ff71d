#include "params/plugin_internal.h"

#include <stdexcept>
#include <utility>

#include "params/mod_param_kinds.h"

namespace plugcore {

void PluginInternal::add_param(std::shared_ptr<NormalizedParamInterface> param) {
  if (!param) {
    throw std::runtime_error("plugcore::PluginInternal::add_param() : Null parameter.");
  }
  if (dynamic_cast<MidiModParam*>(param.get()) != nullptr) {
    midi_mod_params_.push_back(param);
  }
  if (dynamic_cast<MultiModParam*>(param.get()) != nullptr) {
    multi_mod_params_.push_back(param);
  }
  params_.push_back(std::move(param));
  ++nbr_params_;
}

void PluginInternal::add_aux_object_a(std::shared_ptr<void> object) { aux_objects_a_.push_back(std::move(object)); }

void PluginInternal::add_extra_control(std::shared_ptr<void> control) {
  extra_controls_.push_back(ExtraControl{std::move(control), nullptr});
}

void PluginInternal::add_aux_object_b(std::shared_ptr<void> object) { aux_objects_b_.push_back(std::move(object)); }

void* PluginInternal::use_inner_object() { return nullptr; }

void PluginInternal::init_extra_controls() {
  for (ExtraControl& entry : extra_controls_) {
    if (entry.init) {
      entry.init();
    }
  }
}

void PluginInternal::add_extra_control_with_init(std::shared_ptr<void> control, std::function<void()> init) {
  extra_controls_.push_back(ExtraControl{std::move(control), std::move(init)});
}

int PluginInternal::get_nbr_registered_params() const { return nbr_params_; }

NormalizedParamInterface& PluginInternal::use_registered_param(int index) {
  if (index < 0 || index >= nbr_params_) {
    throw std::runtime_error("plugcore::PluginInternal::use_registered_param() : Invalid index.");
  }
  return *params_[static_cast<size_t>(index)];
}

const NormalizedParamInterface& PluginInternal::use_registered_param(int index) const {
  return const_cast<PluginInternal*>(this)->use_registered_param(index);
}

int PluginInternal::get_nbr_extra_controls() const { return static_cast<int>(extra_controls_.size()); }

int PluginInternal::get_nbr_midi_mod_params() const { return static_cast<int>(midi_mod_params_.size()); }

int PluginInternal::get_nbr_multi_mod_params() const { return static_cast<int>(multi_mod_params_.size()); }

int PluginInternal::get_nbr_aux_objects_a() const { return static_cast<int>(aux_objects_a_.size()); }

int PluginInternal::get_nbr_aux_objects_b() const { return static_cast<int>(aux_objects_b_.size()); }

int PluginInternal::get_nbr_input_groups() const { return static_cast<int>(input_groups_.size()); }

int PluginInternal::get_nbr_output_groups() const { return static_cast<int>(output_groups_.size()); }

const PinGroup& PluginInternal::get_input_group(int index) const {
  if (index < 0 || index >= get_nbr_input_groups()) {
    throw std::runtime_error("plugcore::PluginInternal::get_input_group() : Invalid index.");
  }
  return input_groups_[static_cast<size_t>(index)];
}

const PinGroup& PluginInternal::get_output_group(int index) const {
  if (index < 0 || index >= get_nbr_output_groups()) {
    throw std::runtime_error("plugcore::PluginInternal::get_output_group() : Invalid index.");
  }
  return output_groups_[static_cast<size_t>(index)];
}

void PluginInternal::add_input_group(PinGroup group) { input_groups_.push_back(std::move(group)); }

void PluginInternal::add_output_group(PinGroup group) { output_groups_.push_back(std::move(group)); }

}  // namespace plugcore
