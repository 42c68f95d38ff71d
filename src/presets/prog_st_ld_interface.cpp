#include "presets/prog_st_ld_interface.h"

#include <stdexcept>

#include "host/dsp_interface.h"
#include "host/host_gui_interface.h"
#include "presets/bank_manager.h"
#include "presets/program_slot.h"

namespace plugcore {

namespace {
template <typename T>
T& checked(T* object, const char* operation) {
  if (object == nullptr) {
    throw std::runtime_error(std::string(operation) + " : No context.");
  }
  return *object;
}
}  // namespace

void ProgStLdInterface::set_context(BankManager* bank, HostGuiInterface* host_gui, DspInterface* dsp) {
  bank_ = bank;
  host_gui_ = host_gui;
  dsp_ = dsp;
}

void ProgStLdInterface::store_current(ProgramSlot& slot) const {
  DspInterface& dsp = checked(dsp_, "plugcore::ProgStLdInterface::store_current()");
  slot.set_name(dsp.get_program_name());
  dsp.store_program(slot);
}

void ProgStLdInterface::write_to_bank(int index, const ProgramSlot& slot) const {
  checked(bank_, "plugcore::ProgStLdInterface::write_to_bank()").set_program(index, slot);
}

void ProgStLdInterface::read_from_bank(int index, ProgramSlot& slot) const {
  checked(bank_, "plugcore::ProgStLdInterface::read_from_bank()").get_program(index, slot);
}

void ProgStLdInterface::apply(const ProgramSlot& slot) const {
  DspInterface& dsp = checked(dsp_, "plugcore::ProgStLdInterface::apply()");
  dsp.set_program_name(slot.get_name());
  dsp.load_program(slot);
}

void ProgStLdInterface::apply_mix(const ProgramSlot& from, const ProgramSlot& to, double position) {
  HostGuiInterface& host = checked(host_gui_, "plugcore::ProgStLdInterface::apply_mix()");
  ProgramSlot mixed;
  mixed.set_name(to.get_name());
  mix(mixed, from, to, position);
  host.apply_program(mixed, kPresetPriority);
}

}  // namespace plugcore
