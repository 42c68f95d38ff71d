#pragma once

#include <string>
#include <vector>

namespace basic {
class ConfKeyMulti;
}

namespace plugcore {

class MidiDevSelCompInterface;
class MidiInInterface;
class MidiMgr;
class MidiOutInterface;

// Selection of one MIDI device per direction.
class MidiDevSelectorInterface {
 public:
  virtual ~MidiDevSelectorInterface() = default;
  virtual int get_nbr_inputs() const = 0;
  virtual int get_nbr_outputs() const = 0;
  virtual std::string get_input_name(int index) const = 0;
  virtual std::string get_output_name(int index) const = 0;
  virtual int get_selected_input() const = 0;
  virtual int get_selected_output() const = 0;
  virtual int select_input(int index) = 0;
  virtual int select_output(int index) = 0;
};

// Numbers the devices of its components (in registration order), opens and
// closes the selected ones for the MIDI manager, and keeps the choice in the
// "port_in" and "port_out" sections. Runs on the editor thread.
class MidiDevSelDispatcher : public MidiDevSelectorInterface {
 public:
  explicit MidiDevSelDispatcher(MidiMgr* mgr) : mgr_(mgr) {}
  ~MidiDevSelDispatcher() override;

  void add_component(MidiDevSelCompInterface* component);
  int init_components();
  bool is_initialised() const { return initialised_; }
  int list_inputs();
  int list_outputs();

  int get_nbr_inputs() const override { return static_cast<int>(input_names_.size()); }
  int get_nbr_outputs() const override { return static_cast<int>(output_names_.size()); }
  std::string get_input_name(int index) const override;
  std::string get_output_name(int index) const override;
  int get_selected_input() const override { return selected_input_; }
  int get_selected_output() const override { return selected_output_; }
  // Index -1 only closes. A device that cannot be opened leaves the
  // direction without one and returns the error.
  int select_input(int index) override;
  int select_output(int index) override;
  int select_default(bool on);
  // Closes both directions (the instance is going away).
  void close_all();

  int save(basic::ConfKeyMulti& midi) const;
  // Selects the devices named in the section; a missing section keeps the
  // direction as it is. On failure the previous selection is restored.
  int load(const basic::ConfKeyMulti& midi);

 private:
  struct Component {
    MidiDevSelCompInterface* component;
    int first_input = 0;
    int nbr_inputs = 0;
    int first_output = 0;
    int nbr_outputs = 0;
  };
  Component* find_input_owner(int index);
  Component* find_output_owner(int index);
  int find_by_name(const std::vector<std::string>& names, const std::string& name) const;

  MidiMgr* mgr_;
  std::vector<Component> components_;
  std::vector<std::string> input_names_;
  std::vector<std::string> output_names_;
  int selected_input_ = -1;
  int selected_output_ = -1;
  // The components, not their entries: adding a component may move the entries.
  MidiDevSelCompInterface* open_input_owner_ = nullptr;
  MidiDevSelCompInterface* open_output_owner_ = nullptr;
  bool initialised_ = false;
};

}  // namespace plugcore
