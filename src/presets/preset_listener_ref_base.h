#pragma once

namespace plugcore {

class ProgStLdInterface;

// What every preset listener shares: the program count, the program selected
// last and the store/load strategy.
class PresetListenerRefBase {
 public:
  explicit PresetListenerRefBase(int nbr_programs) : nbr_programs_(nbr_programs) {}
  PresetListenerRefBase(const PresetListenerRefBase&) = delete;
  PresetListenerRefBase& operator=(const PresetListenerRefBase&) = delete;
  virtual ~PresetListenerRefBase() = default;

  virtual void stop_all_fades() {}

  int get_nbr_programs() const { return nbr_programs_; }
  // -1 until a program has been selected.
  int get_current_program() const { return current_program_; }
  void set_current_program(int index) { current_program_ = index; }
  void set_strategy(ProgStLdInterface* strategy) { strategy_ = strategy; }
  ProgStLdInterface* use_strategy() const { return strategy_; }

 private:
  const int nbr_programs_;
  int current_program_ = -1;
  ProgStLdInterface* strategy_ = nullptr;
};

}  // namespace plugcore
