#pragma once

namespace plugcore {

class ProgramSlot;

// The one way the editor, the presets and MIDI change parameters and programs;
// every write is arbitrated by priority and time.
class PluginCmdInterface {
 public:
  virtual ~PluginCmdInterface() = default;
  virtual bool can_set_param(int index, int priority) = 0;
  virtual bool lock_param(int index, int priority) = 0;
  virtual void release_param(int index, int priority) = 0;
  virtual bool set_param(int index, float norm, int priority) = 0;
  virtual bool set_param_automated(int index, float norm, int priority) = 0;
  virtual void apply_program(const ProgramSlot& program, int priority, bool release, bool automate) = 0;
};

}  // namespace plugcore
