#pragma once

#include <functional>
#include <memory>
#include <vector>

#include "params/normalized_param_interface.h"
#include "params/pin_group.h"

namespace plugcore {

// The engine's registry: the index of a parameter here is its index for the
// host, the programs, the MIDI map and the editor. Also keeps the pin groups
// the host is shown and the extra MIDI controls.
class PluginInternal {
 public:
  PluginInternal() = default;
  PluginInternal(const PluginInternal&) = delete;
  PluginInternal& operator=(const PluginInternal&) = delete;
  virtual ~PluginInternal() = default;

  virtual void add_param(std::shared_ptr<NormalizedParamInterface> param);
  virtual void add_aux_object_a(std::shared_ptr<void> object);
  virtual void add_extra_control(std::shared_ptr<void> control);
  virtual void add_aux_object_b(std::shared_ptr<void> object);
  virtual void* use_inner_object();
  virtual void init_extra_controls();

  // An extra control together with what initialising it means; the
  // registry cannot call anything on an untyped object by itself.
  void add_extra_control_with_init(std::shared_ptr<void> control, std::function<void()> init);

  int get_nbr_registered_params() const;
  // Throws std::runtime_error for an index outside the registry.
  NormalizedParamInterface& use_registered_param(int index);
  const NormalizedParamInterface& use_registered_param(int index) const;
  int get_nbr_extra_controls() const;
  int get_nbr_midi_mod_params() const;
  int get_nbr_multi_mod_params() const;
  int get_nbr_aux_objects_a() const;
  int get_nbr_aux_objects_b() const;

  int get_nbr_input_groups() const;
  int get_nbr_output_groups() const;
  // Throw std::runtime_error for an index outside the list.
  const PinGroup& get_input_group(int index) const;
  const PinGroup& get_output_group(int index) const;

 protected:
  void add_input_group(PinGroup group);
  void add_output_group(PinGroup group);

  std::vector<PinGroup> input_groups_;
  std::vector<PinGroup> output_groups_;

 private:
  struct ExtraControl {
    std::shared_ptr<void> control;
    std::function<void()> init;
  };

  std::vector<std::shared_ptr<NormalizedParamInterface>> params_;
  int nbr_params_ = 0;
  std::vector<std::shared_ptr<NormalizedParamInterface>> midi_mod_params_;
  std::vector<std::shared_ptr<NormalizedParamInterface>> multi_mod_params_;
  std::vector<ExtraControl> extra_controls_;
  std::vector<std::shared_ptr<void>> aux_objects_a_;
  std::vector<std::shared_ptr<void>> aux_objects_b_;
};

}  // namespace plugcore
