#pragma once

namespace plugcore {

class MidiMgr;

// A tempo request: the caller sets wanted; the answer fills tempo, or raises error
// when the host gave no time information, or clears wanted when its tempo is invalid.
struct TempoQuery {
  double tempo = 0.0;
  bool error = false;
  bool wanted = false;
};

// What the engine may ask of the host and of the core.
class HostDspInterface {
 public:
  virtual ~HostDspInterface() = default;
  virtual int init() = 0;
  virtual double get_property_num(const char* key) = 0;
  virtual void get_tempo(TempoQuery& query) = 0;
  virtual bool is_input_connected(int group, int pin) = 0;
  virtual bool is_output_connected(int group, int pin) = 0;
  virtual MidiMgr* use_midi_mgr() = 0;
};

}  // namespace plugcore
