#pragma once

#include <string>

namespace plugcore {

class MidiDevSelectorInterface;
class MidiMgr;
class ProgramSlot;

// What the editor may ask of the host and of the core.
class HostGuiInterface {
 public:
  virtual ~HostGuiInterface() = default;
  virtual void init() = 0;
  virtual double get_property_num(const char* key) = 0;
  virtual std::string get_property_str(const char* key) = 0;
  virtual bool can_set_param(int index, int priority) = 0;
  virtual bool lock_param(int index, int priority) = 0;
  virtual void release_param(int index, int priority) = 0;
  virtual bool set_param_automated(int index, float norm, int priority) = 0;
  virtual void apply_program(const ProgramSlot& program, int priority) = 0;
  virtual int resize_window(int width, int height) = 0;
  virtual std::string get_setting_path() = 0;
  virtual MidiMgr* use_midi_mgr() = 0;
  // The choice of MIDI ports (the host's and the system's), or null without MIDI.
  virtual MidiDevSelectorInterface* use_midi_dev_selector() = 0;
};

}  // namespace plugcore
