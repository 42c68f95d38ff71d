#pragma once

#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include "midi/midi_controller_sink_interface.h"
#include "midi/midi_out_4b_packet_mixin.h"
#include "midi/midi_receiver_interface.h"
#include "params/plugin_cmd_interface.h"

// Every event a receiver got, as text, in order.
class RecordingReceiver : public plugcore::MidiReceiverInterface {
 public:
  int set_time_stamp(int offset) override { return log("time " + std::to_string(offset)); }
  int note_on(int c, int n, float pitch, int, float velocity, int) override {
    last_pitch = pitch;
    last_velocity = velocity;
    return log("on " + std::to_string(c) + " " + std::to_string(n));
  }
  int note_off(int c, int n, float velocity) override {
    last_velocity = velocity;
    return log("off " + std::to_string(c) + " " + std::to_string(n));
  }
  int key_pressure(int c, int n, float pressure) override {
    last_pressure = pressure;
    return log("pressure " + std::to_string(c) + " " + std::to_string(n));
  }
  int pitch_bend(int c, float semitones) override {
    last_bend = semitones;
    return log("bend " + std::to_string(c));
  }
  int program_change(int c, int p) override { return log("program " + std::to_string(c) + " " + std::to_string(p)); }
  int rpn(int c, int n, int v) override {
    return log("rpn " + std::to_string(c) + " " + std::to_string(n) + " " + std::to_string(v));
  }
  int nrpn(int c, int n, int v) override {
    return log("nrpn " + std::to_string(c) + " " + std::to_string(n) + " " + std::to_string(v));
  }
  int channel_message(int c, int s, int d1, int d2) override {
    return log("raw " + std::to_string(c) + " " + std::to_string(s) + " " + std::to_string(d1) + " " +
               std::to_string(d2));
  }

  // Events other than time stamps and raw copies.
  std::vector<std::string> decoded() const {
    std::vector<std::string> result;
    for (const auto& e : events) {
      if (e.rfind("time", 0) != 0 && e.rfind("raw", 0) != 0) result.push_back(e);
    }
    return result;
  }

  std::vector<std::string> events;
  float last_pitch = 0, last_velocity = 0, last_pressure = 0, last_bend = 0;

 private:
  int log(const std::string& event) {
    events.push_back(event);
    return 1;
  }
};

// The controller keys an input hands on.
class RecordingSink : public plugcore::MidiControllerSinkInterface {
 public:
  void controller_step(int32_t key, int value) override { steps.emplace_back(key, value); }
  int get_nrpn_compatibility() const override { return compatibility; }
  std::vector<std::pair<int32_t, int>> steps;
  int compatibility = 0;
};

// An output that keeps its packets; can refuse after a number of them.
class PacketRecorder : public plugcore::MidiOut4BPacketMixin {
 public:
  using MidiOut4BPacketMixin::MidiOut4BPacketMixin;
  int open() override { return 0; }
  int close() override { return 0; }
  void begin_block() override {}
  void end_block() override {}
  int send_packet(int b0, int b1, int b2, int b3) override {
    if (static_cast<int>(packets.size()) >= accept_limit) return 0;
    packets.push_back({b0, b1, b2, b3});
    return 1;
  }
  std::vector<std::vector<int>> packets;
  int accept_limit = 1 << 30;
};

// Parameter writes as the MIDI manager makes them.
class RecordingCmd : public plugcore::PluginCmdInterface {
 public:
  struct Write {
    int index;
    float norm;
    int priority;
  };
  bool can_set_param(int, int) override { return true; }
  bool lock_param(int, int) override { return true; }
  void release_param(int, int) override {}
  bool set_param(int index, float norm, int priority) override {
    writes.push_back({index, norm, priority});
    return true;
  }
  bool set_param_automated(int index, float norm, int priority) override { return set_param(index, norm, priority); }
  void apply_program(const plugcore::ProgramSlot&, int, bool, bool) override {}
  std::vector<Write> writes;
};

inline std::vector<int> cc(int channel, int controller, int value) { return {0xB0 + channel, controller, value, 0}; }
