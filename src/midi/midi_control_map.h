#pragma once

#include <array>
#include <atomic>
#include <cstdint>
#include <vector>

namespace plugcore {

// Controller keys to parameter (or extra control) indices. The map is changed
// on the editor thread and by the learning step on a decoding thread while
// decoding threads read it, so it is two fixed tables of atomics instead of a
// node-based container: key slot -> index, and index -> key. A binding exists
// exactly when both directions agree, so a race between two writers can at
// worst lose one binding, never tear or overrun an entry. Each index holds at
// most one key.
class MidiControlMap {
 public:
  static constexpr int kMaxIndex = 256;  // indices at or above cannot be bound
  static constexpr int kNbrSlots = 128 + 16384 + 16384;

  MidiControlMap();
  MidiControlMap(const MidiControlMap&) = delete;
  MidiControlMap& operator=(const MidiControlMap&) = delete;

  // Index bound to the key, or -1. Never allocates or blocks.
  int find(int32_t key) const;
  // Key bound to the index, or -1.
  int32_t key_of(int index) const;
  // Removes the index's key, then binds key to it (taking it from any other
  // index). False for a key no controller can produce or an index out of range.
  bool bind(int index, int32_t key);
  void unbind(int index);
  void clear();
  // (key, index) pairs in ascending key order.
  std::vector<std::pair<int32_t, int>> list() const;
  // Copies another map's bindings (editor thread).
  void assign(const std::vector<std::pair<int32_t, int>>& bindings);

  // Slot of a key in the forward table, or -1.
  static int slot_of(int32_t key);

 private:
  std::vector<std::atomic<int16_t>> index_by_slot_;
  std::array<std::atomic<int32_t>, kMaxIndex> key_by_index_;
};

}  // namespace plugcore
