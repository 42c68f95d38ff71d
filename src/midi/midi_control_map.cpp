#include "midi/midi_control_map.h"

#include <algorithm>

#include "midi/midi_controller_key.h"

namespace plugcore {

namespace {
constexpr int kNrpnBase = 128;
constexpr int kRpnBase = 128 + 16384;

}  // namespace

MidiControlMap::MidiControlMap() : index_by_slot_(kNbrSlots) { clear(); }

int MidiControlMap::slot_of(int32_t key) {
  if (key < 0) return -1;
  const int kind = midi_key_kind(key);
  const int number = midi_key_number(key);
  if (kind == kMidiKindNrpn) return number < 16384 ? kNrpnBase + number : -1;
  if (kind == kMidiKindRpn) return number < 16384 ? kRpnBase + number : -1;
  return kind < 128 && number == 0 ? kind : -1;
}

int MidiControlMap::find(int32_t key) const {
  const int slot = slot_of(key);
  if (slot < 0) return -1;
  const int index = index_by_slot_[static_cast<size_t>(slot)].load(std::memory_order_relaxed);
  if (index < 0 || key_by_index_[static_cast<size_t>(index)].load(std::memory_order_relaxed) != key) {
    return -1;
  }
  return index;
}

int32_t MidiControlMap::key_of(int index) const {
  if (index < 0 || index >= kMaxIndex) return -1;
  const int32_t key = key_by_index_[static_cast<size_t>(index)].load(std::memory_order_relaxed);
  return key >= 0 && find(key) == index ? key : -1;
}

bool MidiControlMap::bind(int index, int32_t key) {
  const int slot = slot_of(key);
  if (slot < 0 || index < 0 || index >= kMaxIndex) return false;
  unbind(index);
  const int previous = index_by_slot_[static_cast<size_t>(slot)].load(std::memory_order_relaxed);
  if (previous >= 0 && key_by_index_[static_cast<size_t>(previous)].load(std::memory_order_relaxed) == key) {
    key_by_index_[static_cast<size_t>(previous)].store(-1, std::memory_order_relaxed);
  }
  index_by_slot_[static_cast<size_t>(slot)].store(static_cast<int16_t>(index), std::memory_order_relaxed);
  key_by_index_[static_cast<size_t>(index)].store(key, std::memory_order_relaxed);
  return true;
}

void MidiControlMap::unbind(int index) {
  if (index < 0 || index >= kMaxIndex) return;
  const int32_t old = key_by_index_[static_cast<size_t>(index)].exchange(-1, std::memory_order_relaxed);
  const int slot = slot_of(old);
  if (slot >= 0) {
    int16_t expected = static_cast<int16_t>(index);
    index_by_slot_[static_cast<size_t>(slot)].compare_exchange_strong(expected, -1, std::memory_order_relaxed);
  }
}

void MidiControlMap::clear() {
  for (auto& key : key_by_index_) key.store(-1, std::memory_order_relaxed);
  for (auto& index : index_by_slot_) index.store(-1, std::memory_order_relaxed);
}

std::vector<std::pair<int32_t, int>> MidiControlMap::list() const {
  std::vector<std::pair<int32_t, int>> bindings;
  for (int index = 0; index < kMaxIndex; ++index) {
    const int32_t key = key_of(index);
    if (key >= 0) bindings.emplace_back(key, index);
  }
  std::sort(bindings.begin(), bindings.end());
  return bindings;
}

void MidiControlMap::assign(const std::vector<std::pair<int32_t, int>>& bindings) {
  clear();
  for (const auto& binding : bindings) bind(binding.second, binding.first);
}

}  // namespace plugcore
