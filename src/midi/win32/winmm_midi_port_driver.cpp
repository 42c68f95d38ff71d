// System MIDI on Windows: the multimedia MIDI functions.
#include <windows.h>
#include <mmsystem.h>

#include "midi/midi_port_driver_interface.h"

namespace sys {

namespace {

class WinmmMidiPortDriver : public MidiPortDriverInterface {
 public:
  ~WinmmMidiPortDriver() override {
    close_input();
    close_output();
  }

  int list_inputs(std::vector<std::string>& names) override {
    const UINT count = midiInGetNumDevs();
    for (UINT k = 0; k < count; ++k) {
      MIDIINCAPSA caps;
      if (midiInGetDevCapsA(k, &caps, sizeof(caps)) != MMSYSERR_NOERROR) return -1;
      names.emplace_back(caps.szPname);
    }
    return 0;
  }

  int list_outputs(std::vector<std::string>& names) override {
    const UINT count = midiOutGetNumDevs();
    for (UINT k = 0; k < count; ++k) {
      MIDIOUTCAPSA caps;
      if (midiOutGetDevCapsA(k, &caps, sizeof(caps)) != MMSYSERR_NOERROR) return -1;
      names.emplace_back(caps.szPname);
    }
    return 0;
  }

  int open_input(int port, MidiInputSinkInterface* sink) override {
    if (input_ != nullptr && close_input() != 0) return -1;
    sink_ = sink;
    if (midiInOpen(&input_, static_cast<UINT>(port), reinterpret_cast<DWORD_PTR>(&WinmmMidiPortDriver::on_input),
                   reinterpret_cast<DWORD_PTR>(this), CALLBACK_FUNCTION) != MMSYSERR_NOERROR) {
      input_ = nullptr;
      return -1;
    }
    if (midiInStart(input_) != MMSYSERR_NOERROR) {
      midiInClose(input_);
      input_ = nullptr;
      return -1;
    }
    return 0;
  }

  int close_input() override {
    if (input_ == nullptr) return 0;
    midiInStop(input_);
    midiInReset(input_);
    if (midiInClose(input_) != MMSYSERR_NOERROR) return -1;
    input_ = nullptr;  // forgotten only when the close succeeded
    return 0;
  }

  int open_output(int port) override {
    if (output_ != nullptr) return -1;
    if (midiOutOpen(&output_, static_cast<UINT>(port), 0, 0, CALLBACK_NULL) != MMSYSERR_NOERROR) {
      output_ = nullptr;
      return -1;
    }
    return 0;
  }

  int send_short(uint32_t message) override {
    return output_ != nullptr && midiOutShortMsg(output_, message) == MMSYSERR_NOERROR ? 0 : -1;
  }

  int close_output() override {
    if (output_ == nullptr) return 0;
    if (midiOutClose(output_) != MMSYSERR_NOERROR) return -1;
    output_ = nullptr;
    return 0;
  }

 private:
  static void CALLBACK on_input(HMIDIIN, UINT message, DWORD_PTR instance, DWORD_PTR p1, DWORD_PTR p2) {
    if (message != MIM_DATA) return;
    auto* self = reinterpret_cast<WinmmMidiPortDriver*>(instance);
    self->sink_->on_midi_short(static_cast<uint32_t>(p1), static_cast<uint32_t>(p2));
  }

  HMIDIIN input_ = nullptr;
  HMIDIOUT output_ = nullptr;
  MidiInputSinkInterface* sink_ = nullptr;
};

}  // namespace

std::unique_ptr<MidiPortDriverInterface> make_system_midi_driver() { return std::make_unique<WinmmMidiPortDriver>(); }

}  // namespace sys
