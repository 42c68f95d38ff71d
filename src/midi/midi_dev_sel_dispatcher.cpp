#include "midi/midi_dev_sel_dispatcher.h"

#include <cctype>

#include "config/conf_key.h"
#include "midi/midi_dev_interface.h"
#include "midi/midi_dev_sel_comp_interface.h"
#include "midi/midi_mgr.h"

namespace plugcore {

namespace {

bool same_text_ignoring_case(const std::string& a, const std::string& b) {
  if (a.size() != b.size()) return false;
  for (size_t i = 0; i < a.size(); ++i) {
    if (std::tolower(static_cast<unsigned char>(a[i])) != std::tolower(static_cast<unsigned char>(b[i]))) return false;
  }
  return true;
}

const char kNone[] = "none";

}  // namespace

MidiDevSelDispatcher::~MidiDevSelDispatcher() { close_all(); }

void MidiDevSelDispatcher::add_component(MidiDevSelCompInterface* component) {
  components_.push_back(Component{component});
}

int MidiDevSelDispatcher::init_components() {
  for (auto& entry : components_) {
    const int status = entry.component->init();
    if (status != 0) return status;
  }
  initialised_ = true;
  return 0;
}

int MidiDevSelDispatcher::list_inputs() {
  input_names_.clear();
  for (auto& entry : components_) {
    entry.first_input = static_cast<int>(input_names_.size());
    const int status = entry.component->list_inputs(entry.first_input, input_names_);
    entry.nbr_inputs = static_cast<int>(input_names_.size()) - entry.first_input;
    if (status != 0) return status;
  }
  return 0;
}

int MidiDevSelDispatcher::list_outputs() {
  output_names_.clear();
  for (auto& entry : components_) {
    entry.first_output = static_cast<int>(output_names_.size());
    const int status = entry.component->list_outputs(entry.first_output, output_names_);
    entry.nbr_outputs = static_cast<int>(output_names_.size()) - entry.first_output;
    if (status != 0) return status;
  }
  return 0;
}

std::string MidiDevSelDispatcher::get_input_name(int index) const {
  return index >= 0 && index < get_nbr_inputs() ? input_names_[static_cast<size_t>(index)] : std::string();
}

std::string MidiDevSelDispatcher::get_output_name(int index) const {
  return index >= 0 && index < get_nbr_outputs() ? output_names_[static_cast<size_t>(index)] : std::string();
}

MidiDevSelDispatcher::Component* MidiDevSelDispatcher::find_input_owner(int index) {
  for (auto& entry : components_) {
    if (index >= entry.first_input && index < entry.first_input + entry.nbr_inputs) return &entry;
  }
  return nullptr;
}

MidiDevSelDispatcher::Component* MidiDevSelDispatcher::find_output_owner(int index) {
  for (auto& entry : components_) {
    if (index >= entry.first_output && index < entry.first_output + entry.nbr_outputs) return &entry;
  }
  return nullptr;
}

int MidiDevSelDispatcher::select_input(int index) {
  if (open_input_owner_ != nullptr) {
    mgr_->set_input_device(nullptr);  // returns once no other thread uses the device
    const int status = open_input_owner_->close_input();
    if (status != 0) return status;
    open_input_owner_ = nullptr;
  }
  selected_input_ = -1;
  if (index == -1) return 0;
  Component* owner = find_input_owner(index);
  if (owner == nullptr) return -1;
  MidiInInterface* device = nullptr;
  int status = owner->component->open_input(index, device);
  if (status == 0 && device != nullptr) status = device->open();
  if (status != 0 || device == nullptr) {
    owner->component->close_input();
    return status != 0 ? status : -1;
  }
  open_input_owner_ = owner->component;
  selected_input_ = index;
  mgr_->set_input_device(device);
  return 0;
}

int MidiDevSelDispatcher::select_output(int index) {
  if (open_output_owner_ != nullptr) {
    mgr_->set_output_device(nullptr);
    const int status = open_output_owner_->close_output();
    if (status != 0) return status;
    open_output_owner_ = nullptr;
  }
  selected_output_ = -1;
  if (index == -1) return 0;
  Component* owner = find_output_owner(index);
  if (owner == nullptr) return -1;
  MidiOutInterface* device = nullptr;
  int status = owner->component->open_output(index, device);
  if (status == 0 && device != nullptr) status = device->open();
  if (status != 0 || device == nullptr) {
    owner->component->close_output();
    return status != 0 ? status : -1;
  }
  open_output_owner_ = owner->component;
  selected_output_ = index;
  mgr_->set_output_device(device);
  return 0;
}

int MidiDevSelDispatcher::select_default(bool on) {
  if (!on) {
    const int status = select_input(-1);
    return status == 0 ? select_output(-1) : status;
  }
  if (get_nbr_inputs() > 0) {
    const int status = select_input(0);
    if (status != 0) return status;
  }
  return get_nbr_outputs() > 0 ? select_output(0) : 0;
}

void MidiDevSelDispatcher::close_all() {
  select_input(-1);
  select_output(-1);
}

int MidiDevSelDispatcher::save(basic::ConfKeyMulti& midi) const {
  basic::ConfKeyMulti port_in("port_in");
  port_in.add_key(basic::ConfKeyData("name", selected_input_ >= 0 ? get_input_name(selected_input_) : kNone));
  basic::ConfKeyMulti port_out("port_out");
  port_out.add_key(basic::ConfKeyData("name", selected_output_ >= 0 ? get_output_name(selected_output_) : kNone));
  midi.set_key(port_in);
  midi.set_key(port_out);
  return 0;
}

int MidiDevSelDispatcher::find_by_name(const std::vector<std::string>& names, const std::string& name) const {
  for (size_t i = 0; i < names.size(); ++i) {
    if (same_text_ignoring_case(names[i], name)) return static_cast<int>(i);
  }
  return -1;
}

int MidiDevSelDispatcher::load(const basic::ConfKeyMulti& midi) {
  const int previous_input = selected_input_;
  const int previous_output = selected_output_;
  int status = 0;
  if (midi.find_multi("port_in") >= 0) {
    const int index = find_by_name(input_names_, midi.get_string("port_in/name"));
    if (index != selected_input_) status = select_input(index);
  }
  if (status == 0 && midi.find_multi("port_out") >= 0) {
    const int index = find_by_name(output_names_, midi.get_string("port_out/name"));
    if (index != selected_output_) status = select_output(index);
  }
  if (status != 0) {
    if (selected_input_ != previous_input) select_input(previous_input);
    if (selected_output_ != previous_output) select_output(previous_output);
  }
  return status;
}

}  // namespace plugcore
