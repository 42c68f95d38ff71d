#pragma once

#include "presets/generic_preset_listener.h"

namespace sys {
class FileSelector;
}

namespace plugcore {

class BankManager;

// The bank-save button: asks for a file, asks before replacing one, writes the bank.
class PresetSaveBankListener : public GenericPresetListener {
 public:
  // Neither is owned.
  void set_targets(const BankManager* bank, sys::FileSelector* dialog) {
    bank_ = bank;
    dialog_ = dialog;
  }
  void on_event(int32_t code, int32_t argument) override;

 private:
  const BankManager* bank_ = nullptr;
  sys::FileSelector* dialog_ = nullptr;
};

}  // namespace plugcore
