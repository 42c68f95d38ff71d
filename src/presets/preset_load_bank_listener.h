#pragma once

#include "presets/generic_preset_listener.h"

namespace sys {
class FileSelector;
}

namespace plugcore {

class BankManager;

// The bank-load button: asks for a file and reads it strictly into the bank.
class PresetLoadBankListener : public GenericPresetListener {
 public:
  // Neither is owned.
  void set_targets(BankManager* bank, sys::FileSelector* dialog) {
    bank_ = bank;
    dialog_ = dialog;
  }
  void on_event(int32_t code, int32_t argument) override;

 private:
  BankManager* bank_ = nullptr;
  sys::FileSelector* dialog_ = nullptr;
};

}  // namespace plugcore
