#pragma once

namespace plugcore {

class BankManager;
class DspInterface;
class HostGuiInterface;
class ProgramSlot;

// Moves programs between the engine, a bank and the host. Derived classes
// decide how two programs are mixed during a cross-fade.
class ProgStLdInterface {
 public:
  // The priority under which the editor's presets write parameters.
  static constexpr int kPresetPriority = 150;

  virtual ~ProgStLdInterface() = default;
  // out takes a program between from (position 0) and to (position 1).
  virtual void mix(ProgramSlot& out, const ProgramSlot& from, const ProgramSlot& to, double position) = 0;

  // None of them is owned.
  void set_context(BankManager* bank, HostGuiInterface* host_gui, DspInterface* dsp);
  BankManager* use_bank() const { return bank_; }
  HostGuiInterface* use_host_gui() const { return host_gui_; }
  DspInterface* use_dsp() const { return dsp_; }

  // The engine's current name and normalised values into the slot.
  void store_current(ProgramSlot& slot) const;
  // Throw std::runtime_error for an index outside the bank.
  void write_to_bank(int index, const ProgramSlot& slot) const;
  void read_from_bank(int index, ProgramSlot& slot) const;
  // Straight into the engine: name and values, without arbitration.
  void apply(const ProgramSlot& slot) const;
  // A mix named like `to`, written through the host at the preset priority.
  void apply_mix(const ProgramSlot& from, const ProgramSlot& to, double position);

 protected:
  BankManager* bank_ = nullptr;
  HostGuiInterface* host_gui_ = nullptr;
  DspInterface* dsp_ = nullptr;
};

}  // namespace plugcore
